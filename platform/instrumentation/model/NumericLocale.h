// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Numbers with a decimal point on this thread, whatever locale the process runs in.

#pragma once

#include <locale.h>

namespace Vorn {

// While it lives, strtod() and localeconv() follow the C locale on the calling thread. Other
// threads and the process's own locale are not touched; and the process may change its locale
// meanwhile without disturbing this thread.
class NumericLocale {
public:
    NumericLocale() : locale_(newlocale(LC_ALL_MASK, "C", nullptr)), previous_(uselocale(locale_))
    {
    }
    ~NumericLocale()
    {
        uselocale(previous_);
        if (locale_ != nullptr)
            freelocale(locale_);
    }
    NumericLocale(const NumericLocale&) = delete;
    NumericLocale& operator=(const NumericLocale&) = delete;

private:
    locale_t locale_; // null only when memory is short: then the thread keeps its own
    locale_t previous_;
};

} // namespace Vorn
