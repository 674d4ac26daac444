// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Builds a model from the events of a JSON parser and refuses what the format does not have.

#pragma once

#include "platform/instrumentation/model/Model.h"
#include "platform/instrumentation/model/ModelMembers.h"

#include <bitset>
#include <cstdint>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

namespace Vorn {

// Every event throws std::runtime_error naming the place when it does not fit there. No state
// is kept per level of nesting beyond the four levels that the format has.
class ModelBuilder {
public:
    void beginObject();
    void endObject();
    void beginArray();
    void endArray();
    void key(const std::string& name);
    void text(const std::string& value);
    void number(double value);
    void code(std::uint64_t value);     // a number written as an integer that is not negative
    void other(std::string_view value); // true, false and null, as they are written

    // REQUIRES: the document has come to its end.
    std::vector<ModelNode> takeNodes();

private:
    // Where the next value stands.
    enum class Place { Document, Root, Nodes, Node, States };

    std::string pointer() const;
    std::string expected() const;
    [[noreturn]] void refuse(const std::string& found) const;
    [[noreturn]] void fail(const std::string& reason) const;

    bool isFirst(const std::string& name);
    void setType(const std::string& name);
    void setPath(const std::string& path);
    void finishNode();

    Place place_ = Place::Document;
    std::string key_; // of the object that the place is in
    bool hasNodes_ = false;
    std::bitset<ModelMember::all.size()> seen_; // the members of the node so far
    ModelNode node_;
    std::vector<ModelNode> nodes_;
    std::unordered_map<std::string, std::size_t> indicesByPath_;
};

} // namespace Vorn
