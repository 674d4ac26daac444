// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/text/Trim.h"
#include "platform/utilities/KeyValue.h"
#include "platform/utilities/ObjectAccess.h"
#include "platform/utilities/ProviderUtilities.h"

#include <algorithm>
#include <optional>
#include <utility>
#include <vector>

namespace Vorn {

namespace {

constexpr int deepestPath = 8;

struct Key {
    std::string_view name;
    KeyValue value;
};

std::string_view className(const CMPIObjectPath* path)
{
    CMPIStatus status{};
    CMPIString* const name = path->ft->getClassName(path, &status);
    return status.rc == CMPI_RC_OK ? textOf(name) : std::string_view();
}

std::string_view trimmedNamespace(const CMPIObjectPath* path)
{
    CMPIStatus status{};
    CMPIString* const name = path->ft->getNameSpace(path, &status);
    return status.rc == CMPI_RC_OK ? Text::trimmed(textOf(name), "/") : std::string_view();
}

bool sameNamespace(const CMPIObjectPath* a, const CMPIObjectPath* b)
{
    const std::string_view namespaceA = trimmedNamespace(a);
    const std::string_view namespaceB = trimmedNamespace(b);
    return namespaceA.empty() || namespaceB.empty() || isSameName(namespaceA, namespaceB);
}

// Returns the keys to compare; nothing when the broker fails to list them.
std::optional<std::vector<Key>> keysOf(const CMPIObjectPath* path, bool comparesReferences)
{
    CMPIStatus status{};
    const CMPICount count = path->ft->getKeyCount(path, &status);
    if (status.rc != CMPI_RC_OK)
        return std::nullopt;
    std::vector<Key> keys;
    keys.reserve(std::min<CMPICount>(count, 8)); // few classes have more
    for (CMPICount index = 0; index < count; ++index) {
        CMPIString* name = nullptr;
        const CMPIData data = path->ft->getKeyAt(path, index, &name, &status);
        const std::string_view nameText = textOf(name);
        if (status.rc != CMPI_RC_OK || nameText.empty())
            return std::nullopt;
        if (data.type == CMPI_ref && !comparesReferences)
            continue;
        const KeyValue value = keyValue(data);
        if (!std::holds_alternative<KeyAbsent>(value))
            keys.push_back({nameText, value});
    }
    return keys;
}

bool equalPaths(
    const CMPIObjectPath* a, const CMPIObjectPath* b, bool comparesReferences, int depth);

// Compares two values; there is an overload for each type.
struct ValueEquality {
    bool comparesReferences;
    int depth;

    template <typename Value>
    bool operator()(const Value& a, const Value& b) const
    {
        return a == b;
    }
    bool operator()(const CMPIObjectPath* a, const CMPIObjectPath* b) const
    {
        return equalPaths(a, b, comparesReferences, depth + 1);
    }
    bool operator()(KeyAbsent, KeyAbsent) const { return false; }
    bool operator()(KeyUnusable, KeyUnusable) const { return false; }
    template <typename Value, typename Other>
    bool operator()(const Value&, const Other&) const
    {
        return false;
    }
};

// Returns whether each key of one side equals another key of the other side, so that a name listed
// twice cannot stand for two keys.
bool equalKeys(
    const std::vector<Key>& keys, std::vector<Key> partners, const ValueEquality& sameValue)
{
    if (keys.size() != partners.size())
        return false;
    for (const Key& key : keys) {
        const auto partner = std::find_if(partners.begin(), partners.end(),
            [&](const Key& other) { return isSameName(key.name, other.name); });
        if (partner == partners.end() || !std::visit(sameValue, key.value, partner->value))
            return false;
        partners.erase(partner);
    }
    return true;
}

bool equalPaths(
    const CMPIObjectPath* a, const CMPIObjectPath* b, bool comparesReferences, int depth)
{
    if (depth > deepestPath || !isUsable(a) || !isUsable(b))
        return false;
    const std::string_view name = className(a);
    if (name.empty() || !isSameName(name, className(b)) || !sameNamespace(a, b))
        return false;
    const auto keysA = keysOf(a, comparesReferences);
    if (!keysA)
        return false;
    auto keysB = keysOf(b, comparesReferences);
    return keysB && equalKeys(*keysA, *std::move(keysB), {comparesReferences, depth});
}

} // namespace

bool isObjPathsEqual(const CMPIObjectPath* a, const CMPIObjectPath* b, bool comparesReferences)
{
    return equalPaths(a, b, comparesReferences, 0);
}

} // namespace Vorn
