// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "platform/instrumentation/FileStamp.h"
#include "platform/instrumentation/machinefile/MachineFileNode.h"

#include <map>
#include <memory>
#include <mutex>
#include <string>
#include <vector>

namespace Vorn {

// Caches the nodes of model files until the files change. Thread-safe; files are read outside the
// lock.
class MachineFileCache {
public:
    // Returns the cache of this process.
    static MachineFileCache& instance();

    using Nodes = std::shared_ptr<const std::vector<MachineFileNode>>;

    // Returns the nodes that the file describes now. Throws std::runtime_error naming the file, the
    // place in it and the reason.
    Nodes load(const std::string& path);

private:
    // The result of reading a file: its nodes, or the reason why there are none.
    struct Outcome {
        FileStamp stamp;
        Nodes nodes;
        std::string failure;
    };

    static Outcome read(const std::string& path);
    Outcome find(const std::string& path);
    void keep(const std::string& path, const Outcome& outcome);

    std::mutex mutex_;
    std::map<std::string, Outcome> outcomes_;
};

} // namespace Vorn
