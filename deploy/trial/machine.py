# Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

"""Machines of the trial's fleet, whose sensors model files describe."""

import json
import math
import os
import pathlib
import random
from dataclasses import dataclass, field

TRIAL = pathlib.Path(__file__).resolve().parent
RECORDINGS = (
    TRIAL / "machines/server.json",
    TRIAL.parent.parent / "schema/demo-model.json",
    TRIAL / "machines/twosocket.json",
)

# Codes of `status` in model files.
NORMAL, LOST, WARNING_LOW, WARNING_HIGH, CRITICAL_LOW, CRITICAL_HIGH = 1, 13, 22, 23, 25, 26


def first_limit(node, *names):
    """Returns the first of the limits that the node has, None when it has none."""
    return next((node[name] for name in names if name in node), None)


def healthy_range(node):
    """Returns a reading that is far from limits, and by how much it may vary.

    The reading is the recorded one unless that is missing or near a limit.
    """
    lower = first_limit(node, "lowerNonCritical", "lowerCritical") or 0
    upper = first_limit(node, "upperNonCritical", "upperCritical") or {
        "temperature": 90,
        "voltage": 2 * node.get("reading", 1),
        "tachometer": 6000,
    }.get(node["type"])
    margin = (upper - lower) / 5
    reading = node.get("reading")
    if reading is None or not lower + margin < reading < upper - 2 * margin:
        reading = (lower + upper) / 2
    return reading, margin / 4


def status_of(node):
    """Returns the code of the status that the reading has by the limits."""
    limits = (
        (CRITICAL_HIGH, "upperCritical", 1),
        (CRITICAL_LOW, "lowerCritical", -1),
        (WARNING_HIGH, "upperNonCritical", 1),
        (WARNING_LOW, "lowerNonCritical", -1),
    )
    for code, limit, direction in limits:
        if limit in node and direction * (node["reading"] - node[limit]) >= 0:
            return code
    return NORMAL


@dataclass
class Machine:
    """A machine of a rack. Its number determines which recording it has and how it varies."""

    number: int
    site: str
    rack: str
    address: str
    folder: pathlib.Path
    nodes: list = field(default_factory=list)
    ranges: list = field(default_factory=list)

    def __post_init__(self):
        self._random = random.Random(self.number)
        recording = RECORDINGS[self.number % len(RECORDINGS)]
        self.nodes = json.loads(recording.read_text(encoding="utf-8"))["nodes"]
        for node in self.nodes:
            reading, variation = healthy_range(node)
            self.ranges.append((reading + self._random.uniform(-1, 1) * variation, variation))

    @property
    def model(self):
        """The path of the model file."""
        return self.folder / f"machine-{self.number}.json"

    def write(self, minute, incidents):
        """Renews the model file: what the sensors read at that minute."""
        wave = math.sin(minute / 7 + self.number)
        nodes = []
        for node, (reading, variation) in zip(self.nodes, self.ranges):
            drift = variation * (0.2 * wave + self._random.uniform(-0.1, 0.1))
            digits = 3 if node["type"] == "voltage" else 0
            nodes.append(node | {"reading": round(reading + drift, digits)})
        for incident in incidents:
            nodes = incident.change(self, nodes, minute)
        for node in nodes:
            node["status"] = status_of(node) if "reading" in node else LOST
        # The server must not read half a file.
        draft = self.model.with_suffix(".draft")
        draft.write_text(json.dumps({"nodes": nodes}), encoding="utf-8")
        os.replace(draft, self.model)
