// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tests/model/FailingAllocation.h"

#include <cstdlib>
#include <new>

namespace {

thread_local std::size_t failingSize = 0; // 0 for none

} // namespace

void* operator new(std::size_t size)
{
    if (failingSize != 0 && size == failingSize)
        throw std::bad_alloc();
    if (void* const memory = std::malloc(size))
        return memory;
    throw std::bad_alloc();
}

void operator delete(void* memory) noexcept
{
    std::free(memory);
}

void operator delete(void* memory, std::size_t) noexcept
{
    std::free(memory);
}

namespace Testing {

FailingAllocation::FailingAllocation(std::size_t size)
{
    failingSize = size;
}

FailingAllocation::~FailingAllocation()
{
    failingSize = 0;
}

} // namespace Testing
