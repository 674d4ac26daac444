// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Requests in files, most of them hostile, and their answers.
//
// NAME.exchange contains the request, the line `-- Answer:`, all answers without carriage returns
// and dates, and a line on the end of the connection. A CR LF is sent after each line of the
// request, except for a line that ends with a backslash. Within a line, \r, \n, \0 and \xNN stand
// for a byte.

#include "tests/host/http/HttpTest.h"
#include "tests/support/Texts.h"

namespace HttpTests {

namespace {

const std::filesystem::path folder = SENSOR_PROFILE_SOURCE_DIR "/tests/data/http";

// Removes the escape at the beginning of the text. Returns its byte.
char takeEscape(std::string_view& text)
{
    const std::string_view digits = text.substr(std::min<std::size_t>(text.size(), 2), 2);
    const char kind = text.size() > 1 ? text[1] : '\0';
    text.remove_prefix(std::min<std::size_t>(text.size(), kind == 'x' ? 4 : 2));
    switch (kind) {
    case 'r':
        return '\r';
    case 'n':
        return '\n';
    case '0':
        return '\0';
    case 'x':
        return static_cast<char>(std::stoi(std::string(digits), nullptr, 16));
    default:
        throw std::invalid_argument("there is no such escape");
    }
}

// Returns the bytes of a request from its lines.
std::string bytesOf(std::string_view lines)
{
    std::string bytes;
    while (!lines.empty()) {
        if (lines.starts_with("\\\n")) {
            lines.remove_prefix(2);
        } else if (lines.starts_with('\\')) {
            bytes += takeEscape(lines);
        } else {
            bytes += lines.starts_with('\n') ? "\r\n" : std::string(1, lines.front());
            lines.remove_prefix(1);
        }
    }
    return bytes;
}

// Returns the answers without carriage returns and dates. The page of a refusal by the HTTP library
// itself is left out: the library sends some twice.
std::string described(const std::string& answers)
{
    const bool isOfLibrary = answers.find("<html>") != std::string::npos;
    std::istringstream lines(answers);
    std::string text;
    for (std::string line; std::getline(lines, line);) {
        if (line.ends_with('\r'))
            line.pop_back();
        if (!line.starts_with("Date: "))
            text += line + '\n';
        if (isOfLibrary)
            return text + "in words of the HTTP library\n";
    }
    return text;
}

// The ways in which a connection ends. Where it stays open, a further request ends it.
const std::string staysOpen = "-- The connection stays open.\n";
const std::string isClosed = "-- The connection is closed.\n";
const std::string isClosedThen = "-- The connection is closed when the client ends sending.\n";

class RequestFilesTest : public HttpTest, public testing::WithParamInterface<std::string> {
protected:
    void SetUp() override { start(); }
    // The server still serves requests.
    void TearDown() override { EXPECT_EQ(ask(post()).status, 200); }

    std::string outcome(const std::string& request, const std::string& expectedEnd) const
    {
        HttpClient client = connect();
        client.send(request + (expectedEnd == staysOpen ? post("Connection: close\r\n") : ""));
        if (expectedEnd == isClosedThen)
            client.endSending();
        std::string answers;
        while (!client.isClosed())
            answers += client.receiveSome();
        if (expectedEnd != staysOpen)
            return described(answers) + expectedEnd;
        const std::size_t last = answers.rfind("HTTP/1.1 200 ");
        const bool isAnswered = answers.ends_with("\r\n\r\n<answer/>") &&
                                answers.find("\r\nConnection: close\r\n", last) != answers.npos;
        return described(answers.substr(0, last)) + (isAnswered ? staysOpen : isClosed);
    }
};

TEST_P(RequestFilesTest, OutcomeIsTheExpectedOne)
{
    const std::string content = Testing::contentOf(folder / (GetParam() + ".exchange"));
    const std::string separator = "-- Answer:\n";
    const std::size_t requestEnd = content.find(separator);
    ASSERT_NE(requestEnd, content.npos);
    const std::string expected = content.substr(requestEnd + separator.size());
    const std::string end = expected.substr(std::min(expected.rfind("-- "), expected.size()));
    ASSERT_TRUE(end == staysOpen || end == isClosed || end == isClosedThen) << end;
    EXPECT_EQ(outcome(bytesOf(content.substr(0, requestEnd)), end), expected);
}

INSTANTIATE_TEST_SUITE_P(
    Files, RequestFilesTest, testing::ValuesIn(Testing::fileStemsIn(folder)), [](const auto& file) {
        return Testing::replaced(Testing::replaced(file.param, "-", "_"), ".", "_");
    });

} // namespace

} // namespace HttpTests
