// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The sensors that a model file describes.

#pragma once

#include "platform/instrumentation/Source.h"
#include "platform/instrumentation/model/Model.h"

#include <memory>
#include <string>
#include <vector>

namespace Vorn {

// Serves the file as it was when the source was made. Readings are the file's values.
class ModelSource final : public Source {
public:
    // Throws std::runtime_error naming the file, the place in it and the reason.
    explicit ModelSource(const std::string& path);

    std::vector<Node> nodes(NodeLexicon::NodeType type) override;
    NodeReading read(const Node& node) override;

private:
    std::shared_ptr<const Model> model_;
};

} // namespace Vorn
