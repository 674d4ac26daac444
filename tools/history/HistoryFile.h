// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "tools/history/SensorHistory.h"

#include <cstddef>
#include <functional>
#include <string>

namespace Tools {

// Writes what is needed to restore the history, piece by piece. Samples may be added meanwhile:
// each sensor is written as it was when the call began.
void storeHistory(const SensorHistory& history,
    const std::function<void(const void* bytes, std::size_t count)>& write);

struct StoredHistory {
    SensorHistory::Entries entries;
    SlotNumber newest;
};

// Returns what storeHistory() wrote. `read` returns false where there are not as many bytes. Throws
// std::runtime_error with the reason where the bytes are malformed.
StoredHistory parseHistory(const std::function<bool(void* bytes, std::size_t count)>& read);

// Replaces the file by one with the history, compressed and with a checksum (RFC 1952). The new
// file is FILE.new until it is complete. Throws std::runtime_error with the file and the reason.
// REQUIRES: no other process does so with the same file.
void writeHistoryFile(const std::string& file, const SensorHistory& history);

// Restores the history from such a file. Changes nothing where there is none. Throws
// std::runtime_error with the file and the reason where it cannot be read or is malformed.
void readHistoryFile(const std::string& file, SensorHistory& history);

} // namespace Tools
