// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The objects of root/interop in which the object manager describes itself to clients: its
// namespaces and itself.

#pragma once

#include "host/broker/Arena.h"

#include <string>
#include <string_view>
#include <vector>

namespace Host {

class Instance;
class Repository;

inline constexpr const char* interopNameSpace = "root/interop";
inline constexpr const char* namespaceClass = "CIM_Namespace";
inline constexpr const char* objectManagerClass = "CIM_ObjectManager";

// A snapshot of the objects.
class InteropObjects {
public:
    // REQUIRES: a request runs on this thread. The classes must outlive the objects.
    InteropObjects(const Repository& classes, const std::string& hostName);

    // Returns the instances of the class, which live as long as the request.
    std::vector<const Instance*> ofClass(std::string_view className) const;

private:
    void addObjectManager(const std::string& hostName);
    void addNamespace(const std::string& hostName, const std::string& name);
    Instance& add(const char* className);
    void setText(Instance& instance, const char* name, std::string_view text);
    void setCodes(Instance& instance, const char* name, unsigned only);

    const Repository& classes_;
    Arena& arena_ = Arena::required();
    std::vector<const Instance*> objects_;
};

} // namespace Host
