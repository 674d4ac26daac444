// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Localised texts with one insert.

#pragma once

#include <string>

namespace Vorn {

// A text that holds exactly one %s, in the language of a resource library: that of "de" for
// "de_AT", and English for a language or a component that has no texts. Thread-safe.
class ResourceString {
public:
    // `library` is a name from Locale::getResourceLibrary. `messageId` is, for instance,
    // MSGID_SENSOR_CAPTION; the text of an unknown message is the insert alone.
    ResourceString(const std::wstring& library, const std::wstring& messageId);

    // Returns a format for formatText.
    const std::wstring& text() const noexcept { return text_; }

private:
    std::wstring text_;
};

} // namespace Vorn
