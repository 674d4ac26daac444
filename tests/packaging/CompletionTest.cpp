// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The completions of bash for command lines of sensorctl.

#include "tests/packaging/Installation.h"
#include "tests/support/TemporaryFolder.h"
#include "tests/tools/ToolTest.h"

#include <gmock/gmock.h>

namespace CompletionTests {

using testing::Contains;
using testing::Each;
using testing::ElementsAre;
using testing::StartsWith;
using namespace Testing;

// Returns the completions of the last word.
std::vector<std::string> offersFor(const std::vector<std::string>& words)
{
    const std::string script = R"(
        source "$0/share/bash-completion/completions/sensorctl"
        COMP_WORDS=(sensorctl "$@") COMP_CWORD=$#
        _sensorctl "$0/bin/sensorctl" "${COMP_WORDS[-1]}" "${COMP_WORDS[-2]}"
        [ ${#COMPREPLY[@]} -eq 0 ] || printf '%s\n' "${COMPREPLY[@]}")";
    std::vector<std::string> arguments = {"-c", script, movedInstallation().string()};
    arguments.insert(arguments.end(), words.begin(), words.end());
    const Ended ended = run(arguments, {.program = "/bin/bash"});
    EXPECT_EQ(ended.err, "");
    return linesOf(ended.out);
}

TEST(CompletionTest, OffersCommands)
{
    EXPECT_THAT(offersFor({""}), testing::IsSupersetOf({"list", "get", "walk", "record"}));
    EXPECT_THAT(offersFor({"re"}), ElementsAre("record"));
}

TEST(CompletionTest, OffersTheOptionsOfTheCommand)
{
    EXPECT_THAT(offersFor({"list", "--"}),
        testing::UnorderedElementsAre("--help", "--model", "--provider", "--json", "--cim",
            "--flat", "--csv", "--color", "--kind", "--problems"));
    EXPECT_THAT(offersFor({"record", "--o"}), ElementsAre("--output"));
    EXPECT_THAT(offersFor({"--v"}), ElementsAre("--version"));
}

TEST(CompletionTest, OffersValues)
{
    EXPECT_THAT(offersFor({"list", "--color", "a"}), ElementsAre("auto", "always"));
    EXPECT_THAT(offersFor({"serve", "--compatible", ""}), ElementsAre("node_exporter"));
    EXPECT_THAT(offersFor({"list", "ZUMLO_S"}), Each(StartsWith("ZUMLO_Sensor")));
    EXPECT_THAT(offersFor({"list", "ZUMLO_N"}), ElementsAre("ZUMLO_NumericSensor"));
    for (const char* const option : {"--model", "-o", "--output"})
        EXPECT_THAT(offersFor({"record", option, "/etc/host"}), Contains("/etc/hosts"));
    EXPECT_THAT(offersFor({"serve", "--user", "roo"}), Contains("root"));
}

TEST(CompletionTest, OffersChipsAndLabels)
{
    const std::string model = installedFile("share/sensor-profile/demo-model.json");
    EXPECT_THAT(
        offersFor({"list", "--model", model, "NVMe"}), ElementsAre("NVMe 1 Temp", "NVMe 2 Temp"));
    EXPECT_THAT(offersFor({"get", "--model", model, "--json", "system/n"}),
        ElementsAre("system/nic1", "system/nvme1", "system/nvme2"));
    EXPECT_THAT(offersFor({"list", "--kind", "v"}), ElementsAre("voltage"));
}

TEST(CompletionTest, OffersChipsAndLabelsInAnyLetterCase)
{
    const std::string model = installedFile("share/sensor-profile/demo-model.json");
    EXPECT_THAT(
        offersFor({"list", "--model=" + model, "nvme"}), ElementsAre("NVMe 1 Temp", "NVMe 2 Temp"));
    EXPECT_THAT(offersFor({"list", "--model", "=", model, "nvme 2"}), ElementsAre("NVMe 2 Temp"));
}

TEST(CompletionTest, OffersLabelsWithoutExpandingThem)
{
    TemporaryFolder folder;
    folder.write("model.json", R"({"nodes": [
        {"type": "temperature", "path": "/a/1", "description": "Fan 'A"},
        {"type": "temperature", "path": "/a/2", "description": "Fan $(kill $$) `kill $$` *"}]})");
    EXPECT_THAT(offersFor({"list", "--model", folder.path() / "model.json", "fan"}),
        ElementsAre("Fan $(kill $$) `kill $$` *", "Fan 'A"));
}

TEST(CompletionTest, OffersNoFilesForOtherThings)
{
    EXPECT_THAT(offersFor({"get", "/etc/host"}), testing::IsEmpty());
    EXPECT_THAT(offersFor({"get", "--cim", "/etc/host"}), testing::IsEmpty());
    EXPECT_THAT(offersFor({"serve", "--port", "/etc/host"}), testing::IsEmpty());
}

} // namespace CompletionTests
