// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include <malloc.h>

#include <cstddef>

namespace Tools {

// Has the allocator keep the memory of an answer for the next one: mapping it again page by page
// takes a third of the time in which its objects are made. Each arena of the allocator keeps up to
// 8 MiB, so that their number is limited to that of the workers. REQUIRES: the process has one
// thread.
inline void keepFreedMemory(std::size_t workers)
{
    ::mallopt(M_ARENA_MAX, static_cast<int>(workers));
    ::mallopt(M_MMAP_THRESHOLD, 2 << 20);
    ::mallopt(M_TRIM_THRESHOLD, 8 << 20);
}

// Returns the free memory of the allocator to the system.
inline void returnFreedMemory()
{
    ::malloc_trim(0);
}

// The number of objects, or of sensors in a scrape, from which on the free memory is returned to
// the system after an answer. So many objects take forty megabytes, and a scrape leaves twenty.
// Mapping them again takes a sixth of the time of a scrape, and a small part of that of an answer.
inline constexpr std::size_t largeAnswer = 10'000;

} // namespace Tools
