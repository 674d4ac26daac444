// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The descriptors of the chips' folders.

#include "platform/instrumentation/hwmon/HwmonSource.h"
#include "platform/utilities/Descriptor.h"
#include "tests/platform/instrumentation/HwmonMachine.h"

#include <fcntl.h>
#include <gtest/gtest.h>
#include <sys/resource.h>

#include <iterator>
#include <stdexcept>
#include <string>
#include <utility>
#include <vector>

namespace HwmonFoldersTests {

using Testing::BoundSysfs;
using Vorn::NodeLexicon::NodeType;

using HwmonFoldersTest = Testing::HwmonTest;

// The descriptor that lists the folder is one of them, in every call.
std::ptrdiff_t openDescriptors()
{
    const std::filesystem::directory_iterator entries("/proc/self/fd");
    return std::distance(begin(entries), end(entries));
}

void plugIn(BoundSysfs& sysfs, int chip)
{
    const std::string name = "hwmon" + std::to_string(chip);
    sysfs.addChip(name, "board", "platform", "board." + std::to_string(chip));
    sysfs.write("hwmon/" + name + "/temp1_input", std::to_string(chip * 1000) + "\n");
    sysfs.write("hwmon/" + name + "/temp2_input", std::to_string(chip * 1000 + 500) + "\n");
}

TEST_F(HwmonFoldersTest, AnOpenDescriptorStaysForEachChip)
{
    BoundSysfs sysfs("");
    Testing::walk();
    const auto before = openDescriptors();
    plugIn(sysfs, 1);
    plugIn(sysfs, 2);
    for (int request = 0; request < 3; ++request) {
        Testing::walk();
        EXPECT_EQ(openDescriptors(), before + 2);
    }
    sysfs.remove("hwmon/hwmon1");
    Testing::walk();
    EXPECT_EQ(openDescriptors(), before + 1);
}

TEST_F(HwmonFoldersTest, PastTheBoundFoldersAreOpenWhileTheyAreRead)
{
    constexpr int chips = 260;
    BoundSysfs sysfs("");
    Testing::walk();
    const auto before = openDescriptors();
    for (int chip = 0; chip < chips; ++chip)
        plugIn(sysfs, chip);
    EXPECT_EQ(Testing::walk().size(), 2U * chips);
    EXPECT_EQ(openDescriptors(), before + 256);

    Vorn::HwmonSource source;
    double sum = 0.0;
    for (const Vorn::Node& node : source.nodes(NodeType::Temperature)) {
        sum += source.read(node).reading.value();
        EXPECT_LE(openDescriptors(), before + 257);
    }
    EXPECT_EQ(sum, chips * (chips - 1) + 0.5 * chips);
}

// Leaves the process as many unused descriptors during its lifetime.
class FewDescriptors {
public:
    explicit FewDescriptors(int unused)
    {
        ::getrlimit(RLIMIT_NOFILE, &before_);
        const ::rlimit low = {64, before_.rlim_max};
        ::setrlimit(RLIMIT_NOFILE, &low);
        for (;;) {
            Vorn::Descriptor used(::open("/", O_PATH | O_CLOEXEC));
            if (!used.isOpen())
                break;
            used_.push_back(std::move(used));
        }
        for (; unused > 0; --unused)
            used_.pop_back();
    }
    ~FewDescriptors() { ::setrlimit(RLIMIT_NOFILE, &before_); }
    FewDescriptors(const FewDescriptors&) = delete;
    FewDescriptors& operator=(const FewDescriptors&) = delete;

private:
    ::rlimit before_{};
    std::vector<Vorn::Descriptor> used_;
};

std::vector<std::string> descriptions()
{
    std::vector<std::string> found;
    for (const Testing::SeenNode& node : Testing::walk())
        found.push_back(node.description);
    return found;
}

TEST_F(HwmonFoldersTest, WithoutDescriptorsARequestFailsAndTheNextIsRight)
{
    BoundSysfs sysfs("");
    Testing::walk(); // closes the folders of the machine of another test
    std::vector<std::string> expected;
    unsigned failures = 0;
    // The undefined-behaviour sanitizer takes two to look at the type of an exception.
    for (int unused = 2; unused < 10; ++unused) {
        const std::string name = "hwmon" + std::to_string(unused);
        sysfs.addChip(name, "board", "platform", "board." + std::to_string(unused));
        sysfs.write("hwmon/" + name + "/temp1_input", "20000\n");
        sysfs.write("hwmon/" + name + "/temp1_label", "Zone " + std::to_string(unused) + "\n");
        expected.push_back("Zone " + std::to_string(unused));
        try {
            const FewDescriptors few(unused);
            EXPECT_EQ(descriptions(), expected) << unused;
        } catch (const std::runtime_error&) {
            ++failures;
        }
        EXPECT_EQ(descriptions(), expected) << unused;
    }
    EXPECT_GT(failures, 0U);
}

TEST_F(HwmonFoldersTest, PastTheBoundAChipThatTookAnothersPlaceIsNotReadForIt)
{
    constexpr int chips = 257;
    BoundSysfs sysfs("");
    for (int chip = 0; chip < chips; ++chip)
        plugIn(sysfs, chip);
    Vorn::HwmonSource source;
    const auto nodes = source.nodes(NodeType::Temperature);
    ASSERT_EQ(nodes.size(), 2U * chips);
    for (const std::string chip : {"hwmon0", "hwmon256"}) {
        sysfs.rename("hwmon/" + chip, "unplugged-" + chip);
        sysfs.addChip(chip, "other", "platform", "other." + chip);
        sysfs.write("hwmon/" + chip + "/temp1_input", "99000\n");
        sysfs.remove("unplugged-" + chip);
    }
    for (const std::size_t index : {std::size_t{0}, nodes.size() - 2}) {
        EXPECT_EQ(source.read(nodes[index]), Vorn::NodeReading{.status = 13}) << nodes[index].path;
        EXPECT_TRUE(source.read(nodes[index + 2 < nodes.size() ? index + 2 : 2]).reading);
    }
}

} // namespace HwmonFoldersTests
