// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "diagnostics/ProviderException.h"

#include <gtest/gtest.h>

#include <memory>

namespace {

using Vorn::ProviderException;

TEST(ProviderExceptionTest, AnEmptyMessageGivesAnEmptyText)
{
    EXPECT_STREQ(ProviderException("").what(), "");
}

TEST(ProviderExceptionTest, ACopyKeepsItsTextWhenTheSourceIsGone)
{
    auto source = std::make_unique<ProviderException>("Failed while setting Device ID");
    const ProviderException copy(*source);
    source.reset();
    EXPECT_STREQ(copy.what(), "Failed while setting Device ID");
}

TEST(ProviderExceptionTest, KeepsItsTextWhenTheCharactersItWasMadeFromAreOverwritten)
{
    char text[] = "Failed while setting Device ID";
    const ProviderException exception(text);
    text[0] = 'x';
    EXPECT_STREQ(exception.what(), "Failed while setting Device ID");
}

TEST(ProviderExceptionTest, TheBaseClassesWhatGivesTheMessage)
{
    const ProviderException exception("Failed while setting Health State");
    const std::exception& base = exception;
    EXPECT_STREQ(base.what(), "Failed while setting Health State");
}

TEST(ProviderExceptionTest, ALongMessageIsKeptWhole)
{
    const std::string text(10000, 'x');
    EXPECT_EQ(ProviderException(text.c_str()).what(), text);
}

} // namespace
