// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "platform/instrumentation/FileStamp.h"
#include "platform/instrumentation/machinefile/ServedMachineFile.h"

#include <map>
#include <memory>
#include <mutex>
#include <string>

namespace Vorn {

// Caches the content of model files until the files change. Thread-safe; files are read outside the
// lock.
class MachineFileCache {
public:
    // Returns the cache of this process.
    static MachineFileCache& instance();

    using Content = std::shared_ptr<const ServedMachineFile>;

    // Returns what the file holds now. Throws std::runtime_error naming the file, the place in it
    // and the reason.
    Content load(const std::string& path);

private:
    // The result of reading a file: its content, or the reason why there is none.
    struct Outcome {
        FileStamp stamp;
        Content content;
        std::string failure;
    };

    static Outcome read(const std::string& path);
    Outcome find(const std::string& path);
    void keep(const std::string& path, const Outcome& outcome);

    std::mutex mutex_;
    std::map<std::string, Outcome> outcomes_;
};

} // namespace Vorn
