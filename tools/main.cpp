// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/CommandLine.h"

int main(int argc, char** argv)
{
    return Tools::runTool(argc, argv);
}
