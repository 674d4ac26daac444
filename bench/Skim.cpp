// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "bench/Skim.h"

#include "host/broker/Names.h"

#include <algorithm>
#include <stdexcept>
#include <string>
#include <string_view>

namespace Bench {

namespace {

// Returns whether the last bytes of an answer in chunks are those of its end: the chunk of length
// 0, and trailer fields.
bool endsInLastChunk(std::string_view tail)
{
    const std::size_t lastChunk = tail.rfind("\r\n0\r\n");
    return lastChunk != std::string_view::npos && tail.ends_with("\r\n\r\n");
}

// Returns the number of bytes after the head; 0 where the answer is in chunks.
std::size_t bodySize(std::string head)
{
    constexpr std::string_view field = "\r\ncontent-length: ";
    std::transform(head.begin(), head.end(), head.begin(), Host::foldCase);
    const std::size_t at = head.find(field);
    return at == std::string::npos ? 0 : std::stoul(head.substr(at + field.size()));
}

} // namespace

std::size_t skim(Testing::HttpClient& client)
{
    constexpr std::size_t tailSize = 512;
    std::string tail = client.receiveSome();
    if (tail.empty())
        return 0;
    std::size_t headSize = tail.find("\r\n\r\n");
    for (; headSize == std::string::npos; headSize = tail.find("\r\n\r\n")) {
        const std::string more = client.receiveSome();
        if (more.empty())
            throw std::runtime_error("an answer was broken off");
        tail += more;
    }
    headSize += 4;
    if (!tail.starts_with("HTTP/1.1 200 "))
        throw std::runtime_error("a request failed: " + tail.substr(0, 500));
    const std::size_t length = bodySize(tail.substr(0, headSize));
    std::size_t count = tail.size();
    while (length == 0 ? !endsInLastChunk(tail) : count < headSize + length) {
        tail.erase(0, tail.size() - std::min(tail.size(), tailSize));
        const std::string more = client.receiveSome();
        if (more.empty())
            throw std::runtime_error("an answer was broken off");
        count += more.size();
        tail += more;
    }
    return count;
}

} // namespace Bench
