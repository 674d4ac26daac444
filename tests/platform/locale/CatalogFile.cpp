// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tests/platform/locale/CatalogFile.h"

#include <cstdint>
#include <vector>

namespace Testing {

namespace {

void appendNumber(std::string& bytes, std::size_t number)
{
    const auto small = static_cast<std::uint32_t>(number);
    bytes.append(reinterpret_cast<const char*>(&small), sizeof small);
}

// A table of lengths and offsets, and the texts it points to behind `base`.
void appendTable(
    std::string& table, std::string& pool, std::size_t base, const std::vector<std::string>& texts)
{
    for (const std::string& text : texts) {
        appendNumber(table, text.size());
        appendNumber(table, base + pool.size());
        pool += text;
        pool += '\0';
    }
}

} // namespace

std::string messageFile(const std::map<std::string, std::string>& texts, const std::string& header)
{
    std::vector<std::string> originals = {""}, translations = {header};
    for (const auto& [id, text] : texts) {
        originals.push_back(id);
        translations.push_back(text);
    }
    constexpr std::size_t headSize = 28;
    const std::size_t tableSize = 8 * originals.size();
    std::string bytes;
    for (const std::size_t number : {std::size_t{0x950412de}, std::size_t{0}, originals.size(),
             headSize, headSize + tableSize, std::size_t{0}, headSize + 2 * tableSize})
        appendNumber(bytes, number);
    std::string pool;
    appendTable(bytes, pool, headSize + 2 * tableSize, originals);
    appendTable(bytes, pool, headSize + 2 * tableSize, translations);
    return bytes + pool;
}

} // namespace Testing
