// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Requests in files with the answers that are expected, for each operation and its options.
//
// NAME.xml is a request, NAME.expected.xml its answer with the elements on lines of their own.
// In both @SYSTEM@ stands for the kernel's host name and @CONTEXT@ for the context of the open
// enumeration. `<!-- after OTHER.xml -->` in a request: the other one is made before it.

#include "host/cimxml/OperationTable.h"
#include "platform/utilities/ProviderUtilities.h"
#include "tests/host/operations/ShippedManager.h"

#include <algorithm>
#include <filesystem>
#include <fstream>
#include <map>
#include <sstream>
#include <vector>

namespace OperationTests {

namespace {

const std::filesystem::path Folder = SENSOR_PROFILE_SOURCE_DIR "/tests/data/cimxml/operations";

std::string contentOf(const std::filesystem::path& file)
{
    std::ifstream in(file);
    EXPECT_TRUE(in.is_open()) << file;
    std::ostringstream content;
    content << in.rdbuf();
    return content.str();
}

std::string replaced(std::string text, std::string_view from, const std::string& to)
{
    for (auto at = text.find(from); at != std::string::npos; at = text.find(from, at + to.size()))
        text.replace(at, from.size(), to);
    return text;
}

// Without line breaks and the indentation after them.
std::string unfolded(const std::string& text)
{
    std::string line;
    std::string whole;
    for (std::istringstream in(text); std::getline(in, line);)
        whole += line.substr(std::min(line.find_first_not_of(' '), line.size()));
    return whole;
}

std::vector<std::string> requests()
{
    std::vector<std::string> names;
    for (const auto& entry : std::filesystem::directory_iterator(Folder))
        if (entry.path().filename().string().find(".expected.") == std::string::npos)
            names.push_back(entry.path().stem().string());
    std::sort(names.begin(), names.end());
    return names;
}

class AnswerFilesTest : public testing::TestWithParam<std::string> {
protected:
    std::string filledIn(const std::string& text) const
    {
        return replaced(replaced(text, "@SYSTEM@", Vorn::getSystemName()), "@CONTEXT@", context_);
    }

    std::string answerToFile(const std::string& name)
    {
        const std::string request = contentOf(Folder / name);
        const std::string before = between(request, "<!-- after ", " -->");
        if (!before.empty())
            answerToFile(before);
        const std::string answer = answerTo(*manager_, filledIn(request));
        if (const std::string context = contextIn(answer); !context.empty())
            context_ = context;
        return answer;
    }

    ShippedManager manager_;
    std::string context_;
};

TEST_P(AnswerFilesTest, theAnswerIsTheExpectedOne)
{
    const std::string answer = answerToFile(GetParam() + ".xml");
    const std::string expected = filledIn(contentOf(Folder / (GetParam() + ".expected.xml")));
    EXPECT_EQ(unfolded(answer), unfolded(expected));
}

INSTANTIATE_TEST_SUITE_P(Files, AnswerFilesTest, testing::ValuesIn(requests()),
    [](const auto& file) { return replaced(file.param, "-", "_"); });

TEST(AnswerFiles, coverEveryOperationWithEachOfItsParameters)
{
    using Host::CimXml::Parameter;
    std::map<std::string, std::string> textsByOperation;
    for (const std::string& name : requests()) {
        const std::string text = contentOf(Folder / (name + ".xml"));
        textsByOperation[between(text, "<IMETHODCALL NAME=\"", "\"")] += text;
    }
    for (const char* const operation :
        {"GetInstance", "EnumerateInstances", "EnumerateInstanceNames", "GetProperty",
            "Associators", "AssociatorNames", "References", "ReferenceNames", "GetClass",
            "EnumerateClasses", "EnumerateClassNames", "GetQualifier", "EnumerateQualifiers",
            "OpenEnumerateInstances", "OpenEnumerateInstancePaths", "OpenAssociatorInstances",
            "OpenAssociatorInstancePaths", "OpenReferenceInstances", "OpenReferenceInstancePaths",
            "PullInstancesWithPath", "PullInstancePaths", "CloseEnumeration"}) {
        const std::string& texts = textsByOperation[operation];
        EXPECT_NE(texts, "") << operation;
        const auto* const form = Host::CimXml::findOperation(operation);
        ASSERT_NE(form, nullptr) << operation;
        for (std::size_t at = 0; at < Host::CimXml::parameterCount; ++at) {
            const auto parameter = static_cast<Parameter>(at);
            const std::string name(nameOf(parameter));
            if (form->required.has(parameter) || form->optional.has(parameter)) {
                EXPECT_NE(texts.find("<IPARAMVALUE NAME=\"" + name + "\">"), std::string::npos)
                    << operation << ' ' << name;
            }
        }
    }
}

} // namespace

} // namespace OperationTests
