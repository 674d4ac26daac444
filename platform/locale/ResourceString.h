// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Localised texts with one insert.

#pragma once

#include <string>

namespace Vorn {

// A text of a message catalog. A text that is missing, or that does not hold exactly one %s
// and no other conversion, is replaced by the built-in English one, so that a catalog is never
// trusted as a format. Catalogs are loaded at their first use and kept until the library is
// unloaded; making another ResourceString costs a look-up. Any thread may make one.
class ResourceString {
public:
    // `library` is a name from Locale::getResourceLibrary, `messageId` for instance
    // MSGID_SENSOR_CAPTION. Throws only for lack of memory.
    ResourceString(const std::wstring& library, const std::wstring& messageId);

    // A format for formatText.
    const std::wstring& text() const noexcept { return text_; }

private:
    std::wstring text_;
};

} // namespace Vorn
