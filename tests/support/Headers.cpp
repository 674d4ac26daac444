// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The program that the tests' precompiled headers are made for.

int main()
{
    return 0;
}
