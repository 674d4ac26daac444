// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Texts in a library that is loaded and unloaded, wherever it is installed.

#include "tests/support/Mappings.h"
#include "tests/support/TemporaryFolder.h"

#include <gtest/gtest.h>

#include <dlfcn.h>

#include <memory>
#include <stdexcept>
#include <string>

namespace ModuleTests {

namespace fs = std::filesystem;
using Testing::isMapped;

// Whether the library finds its French catalog.
bool speaksFrench(const std::string& path)
{
    const std::unique_ptr<void, int (*)(void*)> library(
        ::dlopen(path.c_str(), RTLD_NOW | RTLD_LOCAL), ::dlclose);
    if (!library)
        throw std::runtime_error(::dlerror());
    EXPECT_TRUE(isMapped(fs::canonical(path).string()));
    const auto ask = reinterpret_cast<bool (*)()>(::dlsym(library.get(), "speaksFrench"));
    return ask != nullptr && ask();
}

TEST(LoadedLibrary, LeavesNoMappingWhenItIsUnloaded)
{
    for (int round = 0; round < 50; ++round)
        ASSERT_TRUE(speaksFrench(LOCALE_MODULE));
    EXPECT_FALSE(isMapped(LOCALE_MODULE));
}

class InstalledLibrary : public testing::TestWithParam<std::string> {
protected:
    Testing::TemporaryFolder prefix;

    std::string install() const
    {
        const fs::path folder = prefix.path() / GetParam();
        fs::create_directories(folder);
        fs::copy_file(LOCALE_MODULE, folder / "libmodule.so");
        return (folder / "libmodule.so").string();
    }

    void installCatalogs() const
    {
        fs::create_directories(prefix.path() / "share");
        fs::copy(SENSOR_PROFILE_BINARY_DIR "/share/locale", prefix.path() / "share/locale",
            fs::copy_options::recursive);
    }
};

TEST_P(InstalledLibrary, FindsTheCatalogsOfItsPrefix)
{
    installCatalogs();
    EXPECT_TRUE(speaksFrench(install()));
}

TEST_P(InstalledLibrary, FindsTheCatalogsOfItsPrefixThroughALink)
{
    installCatalogs();
    const Testing::TemporaryFolder elsewhere;
    const fs::path link = elsewhere.path() / "link.so";
    fs::create_symlink(install(), link);
    EXPECT_TRUE(speaksFrench(link.string()));
}

TEST_P(InstalledLibrary, SpeaksEnglishWithoutCatalogs)
{
    EXPECT_FALSE(speaksFrench(install()));
}

INSTANTIATE_TEST_SUITE_P(Layouts, InstalledLibrary,
    testing::Values("lib", "bin", "lib/cmpi", "lib64/cmpi", "lib/x86_64-linux-gnu/cmpi"));

} // namespace ModuleTests
