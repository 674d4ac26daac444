// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// What a provider library looks like to the process that loads it: it looks up a text, and goes.

#include "platform/locale/ResourceString.h"

// Whether the French catalog was found.
extern "C" __attribute__((visibility("default"))) bool speaksFrench()
{
    const Vorn::ResourceString text(L"fr_FR/sensor-profile", L"MSGID_SENSOR_CAPTION");
    return text.text() == L"Capteur %s";
}
