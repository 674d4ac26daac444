// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/locale/MessageFile.h"

#include <cstdint>
#include <cstring>
#include <filesystem>
#include <fstream>
#include <optional>
#include <string_view>
#include <system_error>

namespace Vorn {

namespace {

constexpr std::uintmax_t largestFile = 1U << 20U;

// A plural formula stands in the header; its parser calls itself for every bracket.
constexpr std::size_t longestHeader = 2048;

// The head of the file: seven numbers in the byte order of the machine that compiled it.
struct Head {
    std::uint32_t magic;
    std::uint32_t revision;
    std::uint32_t count;
    std::uint32_t originals;
    std::uint32_t translations;
    std::uint32_t hashSize;
    std::uint32_t hashTable;
};
constexpr std::uint32_t expectedMagic = 0x950412de;

// A place in the file, as the tables of originals and translations list them.
struct Place {
    std::uint32_t length;
    std::uint32_t offset;
};

class Reader {
public:
    explicit Reader(const std::vector<char>& bytes) : bytes_(bytes) {}

    bool holds(std::uint64_t offset, std::uint64_t length) const
    {
        return offset <= bytes_.size() && length <= bytes_.size() - offset;
    }

    // REQUIRES: the file holds it.
    template <typename Value>
    Value at(std::uint64_t offset) const
    {
        Value value{};
        std::memcpy(&value, bytes_.data() + offset, sizeof value);
        return value;
    }

    // The text at the index of a table; nothing when it lies outside or does not end.
    std::optional<std::string_view> text(std::uint32_t table, std::uint32_t index) const
    {
        const auto place = at<Place>(table + std::uint64_t{index} * sizeof(Place));
        if (!holds(place.offset, std::uint64_t{place.length} + 1))
            return std::nullopt;
        const std::string_view text(bytes_.data() + place.offset, place.length);
        if (bytes_[std::size_t{place.offset} + place.length] != '\0')
            return std::nullopt;
        return text;
    }

private:
    const std::vector<char>& bytes_;
};

bool holdsTables(const Reader& file, const Head& head)
{
    const std::uint64_t tableSize = std::uint64_t{head.count} * sizeof(Place);
    const std::uint64_t hashBytes = std::uint64_t{head.hashSize} * sizeof(std::uint32_t);
    return file.holds(head.originals, tableSize) && file.holds(head.translations, tableSize) &&
           file.holds(head.hashTable, hashBytes);
}

// A slot of the hash table is 0 when free, else one more than an index.
bool isSoundHashTable(const Reader& file, const Head& head)
{
    for (std::uint32_t slot = 0; slot < head.hashSize; ++slot) {
        const std::uint64_t offset = head.hashTable + std::uint64_t{slot} * sizeof(std::uint32_t);
        if (file.at<std::uint32_t>(offset) > head.count)
            return false;
    }
    return true;
}

bool isSoundHeader(std::string_view header)
{
    return header.size() <= longestHeader && header.find("charset=UTF-8") != std::string_view::npos;
}

// The header is the translation of the empty text, which sorts first.
bool areSoundTexts(const Reader& file, const Head& head)
{
    for (std::uint32_t index = 0; index < head.count; ++index) {
        const auto original = file.text(head.originals, index);
        const auto translation = file.text(head.translations, index);
        if (!original || !translation)
            return false;
        if (original->empty() != (index == 0))
            return false;
        if (index == 0 && !isSoundHeader(*translation))
            return false;
    }
    return head.count > 0;
}

} // namespace

bool isSoundMessageFile(const std::vector<char>& bytes)
{
    const Reader file(bytes);
    if (!file.holds(0, sizeof(Head)))
        return false;
    const Head head = file.at<Head>(0);
    return head.magic == expectedMagic && head.revision == 0 && holdsTables(file, head) &&
           isSoundHashTable(file, head) && areSoundTexts(file, head);
}

std::vector<char> readMessageFile(const std::string& path)
{
    std::error_code error;
    if (!std::filesystem::is_regular_file(path, error))
        return {};
    const auto size = std::filesystem::file_size(path, error);
    if (error || size > largestFile)
        return {};
    std::vector<char> bytes(static_cast<std::size_t>(size));
    std::ifstream in(path, std::ios::binary);
    in.read(bytes.data(), static_cast<std::streamsize>(bytes.size()));
    if (!in || !isSoundMessageFile(bytes))
        return {};
    return bytes;
}

} // namespace Vorn
