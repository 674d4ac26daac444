// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/http/Privileges.h"

#include <grp.h>
#include <pwd.h>
#include <sys/prctl.h>
#include <unistd.h>

#include <cerrno>
#include <optional>
#include <stdexcept>
#include <system_error>
#include <vector>

namespace Host::Http {

namespace {

struct User {
    ::uid_t id;
    ::gid_t group;
};

std::optional<User> findUser(const std::string& name)
{
    ::passwd entry{};
    ::passwd* found = nullptr;
    std::vector<char> texts(1024);
    int error = 0;
    while (
        (error = ::getpwnam_r(name.c_str(), &entry, texts.data(), texts.size(), &found)) == ERANGE)
        texts.resize(2 * texts.size());
    if (error != 0 || found == nullptr)
        return std::nullopt;
    return User{entry.pw_uid, entry.pw_gid};
}

void require(bool isDone, const std::string& what)
{
    if (!isDone)
        throw std::runtime_error(what + ": " + std::system_category().message(errno));
}

bool hasBecome(const User& user)
{
    ::uid_t ids[3] = {};
    ::gid_t groups[3] = {};
    if (::getresuid(&ids[0], &ids[1], &ids[2]) != 0 ||
        ::getresgid(&groups[0], &groups[1], &groups[2]) != 0)
        return false;
    for (const ::uid_t id : ids)
        if (id != user.id)
            return false;
    for (const ::gid_t group : groups)
        if (group != user.group)
            return false;
    return user.id == 0 || ::setuid(0) != 0;
}

} // namespace

std::string unprivilegedUser()
{
    return findUser("sensor-profile") ? "sensor-profile" : "nobody";
}

bool isRoot()
{
    return ::geteuid() == 0;
}

bool isUser(const std::string& name)
{
    const auto user = findUser(name);
    return user && user->id == ::geteuid();
}

void becomeUser(const std::string& name)
{
    const auto user = findUser(name);
    if (!user)
        throw std::runtime_error("there is no user " + name);
    require(::initgroups(name.c_str(), user->group) == 0, "cannot take the groups of " + name);
    require(::setresgid(user->group, user->group, user->group) == 0,
        "cannot take the group of " + name);
    require(::setresuid(user->id, user->id, user->id) == 0, "cannot become " + name);
    require(::prctl(PR_SET_NO_NEW_PRIVS, 1UL, 0UL, 0UL, 0UL) == 0,
        "cannot renounce further privileges");
    if (!hasBecome(*user))
        throw std::runtime_error("became " + name + ", but kept rights of before");
}

} // namespace Host::Http
