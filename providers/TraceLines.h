// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The line numbers in the instance providers' trace lines. Monitoring scripts match them, so they
// are an interface: they do not follow the source. The association providers' lines do.

#pragma once

namespace Vorn::SensorProfileProvider {

struct FailureLines {
    unsigned message;
    unsigned exit;
};
struct EnumerationLines {
    unsigned entry;
    FailureLines failure;
    unsigned exit;
};
struct GetInstanceLines {
    unsigned entry;
    FailureLines noSuchKey;
    FailureLines enumeration;
    unsigned exit;
};

namespace SensorLines {

inline constexpr EnumerationLines enumInstanceNames = {74, {94, 96}, 114};
inline constexpr EnumerationLines enumInstances = {136, {155, 157}, 170};
inline constexpr GetInstanceLines getInstance = {192, {220, 222}, {251, 253}, 293};

} // namespace SensorLines

namespace CapabilitiesLines {

inline constexpr EnumerationLines enumInstanceNames = {74, {90, 92}, 114};
inline constexpr EnumerationLines enumInstances = {137, {153, 155}, 169};
inline constexpr GetInstanceLines getInstance = {191, {215, 217}, {243, 245}, 283};

} // namespace CapabilitiesLines

} // namespace Vorn::SensorProfileProvider
