# Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

"""Ports for the programs of a trial."""

import random

from trial.fleet import Failure, check_is_free


def free_ports(first, last):
    """Returns the first of five free ports between these.

    Below 32768, no connection gets them by chance. Tests that run at the same time pass other ones.
    """
    while True:
        port = random.randrange(first, last - 5)
        try:
            for each in range(port, port + 5):
                check_is_free(each)
            return port
        except Failure:
            continue
