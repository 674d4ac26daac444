// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/broker/CollectedResult.h"

#include "host/broker/Instance.h"
#include "host/broker/ObjectPath.h"

namespace Host {

void CollectedResult::append(const CollectedResult& other)
{
    instances_.insert(instances_.end(), other.instances_.begin(), other.instances_.end());
    paths_.insert(paths_.end(), other.paths_.begin(), other.paths_.end());
    refused_ += other.refused_;
}

void CollectedResult::keepOnly(
    const std::function<bool(std::string_view, std::string_view)>& isWanted)
{
    const auto isUnwanted = [&](const auto* object) {
        return !isWanted(object->nameSpace(), object->className());
    };
    std::erase_if(instances_, isUnwanted);
    std::erase_if(paths_, isUnwanted);
}

} // namespace Host
