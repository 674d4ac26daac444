// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// `private_mounts COMMAND [ARGUMENT]...` executes a command in a mount namespace of its own, whose
// mounts other namespaces never see. `unshare --mount` does so only where / is a mount point, which
// it is not in a chroot. Needs root.

#include <cerrno>
#include <cstdio>
#include <cstring>

#include <fcntl.h>
#include <sched.h>
#include <sys/mount.h>
#include <unistd.h>

namespace {

// Returns the name of the call that failed, null when none did. Joining a mount namespace changes
// the root directory to that of the namespace, which is a mount point; the descriptor leads back.
const char* makeMountsPrivate()
{
    if (::unshare(CLONE_NEWNS) != 0)
        return "unshare";
    const int root = ::open("/", O_PATH | O_DIRECTORY | O_CLOEXEC);
    const int folder = ::open(".", O_PATH | O_DIRECTORY | O_CLOEXEC);
    const int mounts = ::open("/proc/self/ns/mnt", O_RDONLY | O_CLOEXEC);
    if (root < 0 || folder < 0 || mounts < 0)
        return "open";
    if (::setns(mounts, CLONE_NEWNS) != 0)
        return "setns";
    if (::mount(nullptr, "/", nullptr, MS_REC | MS_PRIVATE, nullptr) != 0)
        return "mount";
    if (::fchdir(root) != 0 || ::chroot(".") != 0 || ::fchdir(folder) != 0)
        return "chroot";
    return nullptr;
}

} // namespace

int main(int argc, char** argv)
{
    const char* failed = argc < 2 ? "no command" : makeMountsPrivate();
    if (failed == nullptr) {
        ::execvp(argv[1], argv + 1);
        failed = argv[1];
    }
    std::fprintf(stderr, "private_mounts: %s: %s\n", failed, std::strerror(errno));
    return 1;
}
