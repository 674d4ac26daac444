// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// A server with a small machine, and the request that its tests send.

#pragma once

#include "tests/support/CimCall.h"
#include "tests/support/HttpClient.h"
#include "tests/support/TlsClient.h"
#include "tests/tools/ServerProcess.h"
#include "tests/tools/ToolTest.h"

#include <sys/stat.h>

#include <filesystem>
#include <string>
#include <utility>
#include <vector>

namespace Testing {

// The password of ann is "secret"; its hash has the least cost.
inline const std::string userLine =
    "ann:$2b$04$abcdefghijklmnopqrstuu2r9OfJnfCsdneAXAGHnS4UpFFP8WIrW\n";
inline const std::string asAnn = "Authorization: Basic YW5uOnNlY3JldA==\r\n";

inline std::string request(
    const std::string& moreFields = "", const std::string& operation = "EnumerateInstanceNames")
{
    return cimRequest(operation, cimClassParameter("ZUMLO_NumericSensor"), moreFields);
}

inline std::size_t sensorsIn(const std::string& answer)
{
    return countOf(answer, "<INSTANCENAME ");
}

inline HttpReply ask(HttpClient client, const std::string& text = request())
{
    client.send(text);
    return client.receive();
}

class ServeTest : public ToolTest {
protected:
    std::vector<std::string> withModel(std::vector<std::string> arguments = {}) const
    {
        arguments.insert(arguments.end(), {"--model", smallModel()});
        return arguments;
    }

    std::string secret(const std::string& name, const std::string& content) const
    {
        const std::string file = folder_.write(name, content);
        ::chmod(file.c_str(), 0600);
        return file;
    }

    // Returns arguments with a certificate for the name, which is made at its first use.
    std::vector<std::string> encrypted(
        const std::string& certificate, std::vector<std::string> arguments = {}) const
    {
        const std::string file = (folder_.path() / certificate).string();
        if (!std::filesystem::exists(file + ".crt"))
            makeCertificate(file, certificate);
        arguments.insert(arguments.end(), {"--certificate", file + ".crt", "--key", file + ".key"});
        return withModel(arguments);
    }

    // Runs a server that is expected not to start.
    static Ended failing(std::vector<std::string> arguments)
    {
        arguments.insert(arguments.begin(), "serve");
        return run(arguments, {.environment = {{"RYNLOG_LOG", "off"}}});
    }
};

} // namespace Testing
