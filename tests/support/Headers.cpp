// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The program that the precompiled headers of the tests belong to.

int main()
{
    return 0;
}
