# Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

"""Writes the file in which the server keeps its history (tools/history/HistoryFile.cpp)."""

import gzip
import math
import struct
import time

from machine import CRITICAL_HIGH, CRITICAL_LOW, HIGH, LOST, LOW, NORMAL, status_of

MAGIC = b"sensors1"
SLOTS, SECONDS_OF_SLOT = 360, 10
MINUTES, SLOTS_OF_MINUTE = 1440, 6
# The numbers of states (tools/sensors/SensorState.cpp) by the codes of model files.
UNKNOWN = 1
NUMBERS = {NORMAL: 2, LOW: 3, HIGH: 4, CRITICAL_LOW: 6, CRITICAL_HIGH: 7, 16: 9, 5: 11, 12: 15,
           LOST: 16}


def samples_of(node, past, slot):
    """Returns what is stored of a sensor whose last sample was taken in that slot."""
    def sample(age):
        value = past(node, age)
        status = node["status"] if value is None else status_of({**node, "reading": value})
        return math.nan if value is None else value, NUMBERS.get(status, UNKNOWN)

    values, states = [math.nan] * SLOTS, [0] * SLOTS
    for age in range(SLOTS):
        place = (slot - age) % SLOTS
        values[place], states[place] = sample((age + 1) * SECONDS_OF_SLOT)
    means, states_of_minutes = [math.nan] * MINUTES, [0] * MINUTES
    for age in range(MINUTES):
        place = (slot // SLOTS_OF_MINUTE - age) % MINUTES
        means[place], states_of_minutes[place] = sample(
            (age + 1) * SLOTS_OF_MINUTE * SECONDS_OF_SLOT)
    minima = [mean - 0.02 * abs(mean) for mean in means]
    maxima = [mean + 0.02 * abs(mean) for mean in means]
    return struct.pack(f"{SLOTS + 3 * MINUTES}f{SLOTS + MINUTES}BI", *values, *minima, *means,
                       *maxima, *states, *states_of_minutes, 1)


def write_history(file, nodes, past):
    """Writes the history of nodes; `past` returns the reading of a node some seconds ago."""
    slot = int(time.time()) // SECONDS_OF_SLOT
    samples = [(f"{node['description']}:{node['path']}".encode(), samples_of(node, past, slot))
               for node in nodes]
    size = len(samples[0][1]) if samples else 0
    with gzip.open(file, "wb", compresslevel=1) as stored:
        stored.write(struct.pack("8sIIq", MAGIC, size, len(samples), slot))
        for device, content in samples:
            stored.write(struct.pack("qQ", slot, len(device)) + device + content)
