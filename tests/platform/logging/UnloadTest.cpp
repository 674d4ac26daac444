// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tests/platform/logging/LogFile.h"
#include "tests/support/ProcessState.h"

#include <gtest/gtest.h>

#include <dlfcn.h>

#include <memory>

namespace UnloadTests {

using Testing::isMapped;
using Testing::LogFile;
using Testing::openDescriptors;

void loadLogAndUnload(const std::string& path)
{
    const std::unique_ptr<void, int (*)(void*)> library(
        ::dlopen(LOGGING_MODULE, RTLD_NOW | RTLD_LOCAL), ::dlclose);
    ASSERT_NE(library, nullptr) << ::dlerror();
    const auto logOneLine =
        reinterpret_cast<void (*)(const char*)>(::dlsym(library.get(), "logOneLine"));
    ASSERT_NE(logOneLine, nullptr);
    logOneLine(path.c_str());
}

TEST(UnloadTest, ALibraryThatLoggedLeavesNoDescriptorAndNoMapping)
{
    const LogFile file;
    loadLogAndUnload(file.path());
    const std::size_t before = openDescriptors();
    constexpr std::size_t rounds = 100;
    for (std::size_t round = 1; round < rounds; ++round)
        loadLogAndUnload(file.path());
    EXPECT_EQ(openDescriptors(), before);
    EXPECT_FALSE(isMapped(LOGGING_MODULE));
    EXPECT_EQ(file.lines().size(), rounds);
}

} // namespace UnloadTests
