# Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

"""Measures the page of a machine with 1,000 sensors: `bench/run page`."""

import os
import pathlib
import statistics
import time

from browser import PageTest
from machine import Machine

SENSORS = 1000
CHANGED = 200  # sensors in each period
PERIOD = 2
PERIODS = 8
LOADS = 9


def processes_below(process):
    """Returns the numbers of a process and all its descendants."""
    children = [int(child) for task in pathlib.Path(f"/proc/{process}/task").iterdir()
                for child in (task / "children").read_text().split()]
    return [process, *(each for child in children for each in processes_below(child))]


def processor_seconds(processes):
    """Returns the time that processors spent on the processes."""
    ticks = 0
    for process in processes:
        fields = pathlib.Path(f"/proc/{process}/stat").read_text().rpartition(")")[2].split()
        ticks += int(fields[11]) + int(fields[12])
    return ticks / os.sysconf("SC_CLK_TCK")


class SpeedBenchmark(PageTest):
    def setUp(self):
        super().setUp()
        self.machine = Machine.of_size(SENSORS)
        self.server = self.serve(self.machine)

    def test_time_until_usable(self):
        seconds = [self.seconds_until_usable() for _ in range(LOADS)]
        print(f"{SENSORS} sensors are usable after {statistics.median(seconds):.2f} s, "
              f"the median of {LOADS} loads ({min(seconds):.2f} to {max(seconds):.2f} s)")

    def test_processor_time_while_live(self):
        self.open(self.server)
        time.sleep(PERIOD)
        shares = sorted(self.share_while_live(period) for period in range(PERIODS))
        print(f"{SENSORS} sensors, of which {CHANGED} change every {PERIOD} s, use "
              f"{100 * statistics.median(shares):.1f} % of a core, the median of {PERIODS} periods "
              f"({100 * shares[0]:.1f} to {100 * shares[-1]:.1f} %)")

    def seconds_until_usable(self):
        """Returns the time from the request until a search has found sensors."""
        self.driver.get("about:blank")
        begin = time.monotonic()
        self.open(self.server)
        found = self.search("board 99")
        seconds = time.monotonic() - begin
        self.assertEqual(10, found)
        return seconds

    def share_while_live(self, period):
        """Returns which part of a core all processes of the browser use in a period."""
        processes = processes_below(self.driver.service.process.pid)
        begin, spent = time.monotonic(), processor_seconds(processes)
        self.machine.change_temperatures(CHANGED, 45 + period % 9)
        time.sleep(PERIOD)
        return (processor_seconds(processes) - spent) / (time.monotonic() - begin)
