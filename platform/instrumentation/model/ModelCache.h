// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Keeps the models of files that did not change since they were read.

#pragma once

#include "platform/instrumentation/FileStamp.h"
#include "platform/instrumentation/model/Model.h"

#include <map>
#include <memory>
#include <mutex>
#include <string>

namespace Vorn {

// All functions may be called from any thread; a file is read outside the lock.
class ModelCache {
public:
    // The cache of this process.
    static ModelCache& instance();

    // The model that the file holds now. Throws std::runtime_error naming the file, the place
    // in it and the reason.
    std::shared_ptr<const Model> load(const std::string& path);

private:
    // What reading a file came to: a model, or the reason why there is none.
    struct Outcome {
        FileStamp stamp;
        std::shared_ptr<const Model> model;
        std::string failure;
    };

    static Outcome read(const std::string& path);
    Outcome find(const std::string& path);
    void keep(const std::string& path, const Outcome& outcome);

    std::mutex mutex_;
    std::map<std::string, Outcome> outcomes_;
};

} // namespace Vorn
