// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "tools/history/SensorHistory.h"

#include <cstddef>
#include <functional>
#include <string>

namespace Tools {

// Writes what is needed to restore the history, piece by piece. It need not stop meanwhile.
void storeHistory(const SensorHistory& history,
    const std::function<void(const void* bytes, std::size_t count)>& write);

struct StoredHistory {
    SensorHistory::Entries entries;
    Slot newest;
};

// Returns what storeHistory() wrote. `read` returns false where there are not as many bytes. Throws
// std::runtime_error with the reason where the bytes are malformed.
StoredHistory parseHistory(const std::function<bool(void* bytes, std::size_t count)>& read);

// Do the same with a file, which is compressed and has a checksum (RFC 1952). Both throw
// std::runtime_error with the file and the reason. Where that fails, and where there is no file to
// read, nothing is changed.
void writeHistoryFile(const std::string& file, const SensorHistory& history);
void readHistoryFile(const std::string& file, SensorHistory& history);

} // namespace Tools
