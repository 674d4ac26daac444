// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/serve/Privileges.h"

#include <grp.h>
#include <pwd.h>
#include <sys/prctl.h>
#include <unistd.h>

#include <cerrno>
#include <stdexcept>
#include <system_error>
#include <vector>

namespace Tools {

namespace {

struct User {
    ::uid_t id;
    ::gid_t group;
};

// Returns nothing where there is no such user, for which getpwnam_r may return an error too.
std::optional<User> findUser(const std::string& name)
{
    ::passwd entry{};
    ::passwd* found = nullptr;
    std::vector<char> texts(1024);
    int error = 0;
    while (
        (error = ::getpwnam_r(name.c_str(), &entry, texts.data(), texts.size(), &found)) == ERANGE)
        texts.resize(2 * texts.size());
    if (error != 0 && error != ENOENT && error != ESRCH)
        throw std::system_error(error, std::generic_category(), "cannot look for user " + name);
    if (found == nullptr)
        return std::nullopt;
    return User{entry.pw_uid, entry.pw_gid};
}

// Returns the name of the user that the process runs as; the number where it has none.
std::string ownName()
{
    ::passwd entry{};
    ::passwd* found = nullptr;
    std::vector<char> texts(1024);
    while (::getpwuid_r(::geteuid(), &entry, texts.data(), texts.size(), &found) == ERANGE)
        texts.resize(2 * texts.size());
    return found != nullptr ? found->pw_name : "user " + std::to_string(::geteuid());
}

void require(bool isDone, const std::string& what)
{
    if (!isDone)
        throw std::runtime_error(what + ": " + std::system_category().message(errno));
}

// REQUIRES: the process is root's.
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
    if (user->id != 0 && ::setuid(0) == 0)
        throw std::runtime_error("became " + name + ", but kept rights of before");
}

} // namespace

std::string renounceRoot(const std::optional<std::string>& wanted)
{
    if (::geteuid() != 0) {
        const auto user = wanted ? findUser(*wanted) : std::nullopt;
        if (wanted && (!user || user->id != ::geteuid()))
            throw std::runtime_error("only root can run the server as another user, " + *wanted);
        return "serving as " + ownName();
    }
    const std::string user = wanted                       ? *wanted
                             : findUser("sensor-profile") ? "sensor-profile"
                                                          : "nobody";
    becomeUser(user);
    return ::geteuid() == 0 ? "serving as root, as --user says" : "serving as " + user;
}

} // namespace Tools
