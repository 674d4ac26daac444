// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Requests in files with the expected responses, for each operation and its options.
//
// NAME.xml contains a request, the line `<!-- response -->` and the response with each element on a
// line of its own. In both, @SYSTEM@ stands for the kernel's host name, @VERSION@ for the version
// of the product, and @CONTEXT@ for the context of the open enumeration. Before a request with
// `<!-- after OTHER.xml -->`, the request of that file is sent.

#include "host/cimxml/OperationTable.h"
#include "platform/utilities/ProviderUtilities.h"
#include "tests/host/operations/ShippedManager.h"

#include <algorithm>
#include <filesystem>
#include <map>
#include <sstream>
#include <vector>

namespace OperationTests {

namespace {

const std::filesystem::path folder = SENSOR_PROFILE_SOURCE_DIR "/tests/data/cimxml/operations";

// Returns the text without line breaks and the indentation after them.
std::string unfolded(const std::string& text)
{
    std::string line;
    std::string whole;
    for (std::istringstream in(text); std::getline(in, line);)
        whole += line.substr(std::min(line.find_first_not_of(' '), line.size()));
    return whole;
}

struct Exchange {
    std::string request;
    std::string response;
};

Exchange exchangeIn(const std::filesystem::path& file)
{
    constexpr std::string_view separator = "<!-- response -->\n";
    const std::string content = Testing::contentOf(file);
    const auto end = content.find(separator);
    if (end == std::string::npos)
        throw std::invalid_argument(file.string() + " has no response");
    return {content.substr(0, end), content.substr(end + separator.size())};
}

class OperationFilesTest : public testing::TestWithParam<std::string> {
protected:
    std::string filledIn(const std::string& text) const
    {
        std::string filled = Testing::replaced(text, "@SYSTEM@", Vorn::getSystemName());
        filled = Testing::replaced(std::move(filled), "@VERSION@", SENSOR_PROFILE_VERSION);
        return Testing::replaced(std::move(filled), "@CONTEXT@", context_);
    }

    std::string responseTo(const std::string& request)
    {
        const std::string before = between(request, "<!-- after ", " -->");
        if (!before.empty())
            responseTo(exchangeIn(folder / before).request);
        const std::string response = answerTo(*manager_, filledIn(request));
        if (const std::string context = contextIn(response); !context.empty())
            context_ = context;
        return response;
    }

    ShippedManager manager_;
    std::string context_;
};

TEST_P(OperationFilesTest, ResponseIsTheExpectedOne)
{
    const Exchange exchange = exchangeIn(folder / (GetParam() + ".xml"));
    const std::string response = responseTo(exchange.request);
    EXPECT_EQ(unfolded(response), unfolded(filledIn(exchange.response)));
}

INSTANTIATE_TEST_SUITE_P(Files, OperationFilesTest, testing::ValuesIn(Testing::fileStemsIn(folder)),
    [](const auto& file) { return Testing::replaced(file.param, "-", "_"); });

TEST(OperationFilesCoverageTest, HasEveryOperationWithEachOfItsParameters)
{
    using Host::CimXml::Parameter;
    std::map<std::string, std::string> textsByOperation;
    for (const std::string& name : Testing::fileStemsIn(folder)) {
        const std::string text = exchangeIn(folder / (name + ".xml")).request;
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
