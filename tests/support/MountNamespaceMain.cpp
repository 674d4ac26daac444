// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Runs the tests in a mount namespace of their own.

#include "tests/support/MountNamespace.h"

#include <gmock/gmock.h>

int main(int argc, char** argv)
{
    Testing::enterMountNamespace(argv);
    testing::InitGoogleMock(&argc, argv);
    return RUN_ALL_TESTS();
}
