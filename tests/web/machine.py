# Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

"""A machine whose sensors a test moves, in the form of a model file."""

import contextlib
import json
import pathlib

ROOT = pathlib.Path(__file__).resolve().parents[2]

NORMAL, LOW, HIGH, CRITICAL_LOW, CRITICAL_HIGH, LOST = 1, 22, 23, 25, 26, 13


def status_of(node):
    """Returns the status that the kernel's driver would give the reading of a node."""
    reading = node["reading"]
    for limit, status, is_upper in (
            ("lowerCritical", CRITICAL_LOW, False), ("upperCritical", CRITICAL_HIGH, True),
            ("lowerNonCritical", LOW, False), ("upperNonCritical", HIGH, True)):
        if limit in node and (reading >= node[limit] if is_upper else reading <= node[limit]):
            return status
    return NORMAL


class Machine:
    """The nodes of a model file. Calls `on_change` after each change."""

    def __init__(self, nodes):
        self._nodes = {node["path"]: dict(node) for node in nodes}
        self.on_change = lambda: None

    @classmethod
    def demonstration(cls):
        """Returns the machine that the product shows where there are no sensors."""
        return cls(json.loads((ROOT / "schema/demo-model.json").read_text())["nodes"])

    @classmethod
    def of_size(cls, count, per_chip=10):
        """Returns a machine of that many sensors of all kinds."""
        kinds = (("temperature", 2, 45, {"upperNonCritical": 85, "upperCritical": 95}),
                 ("voltage", 5, 12.04, {"lowerCritical": 10.8, "upperCritical": 13.2}),
                 ("tachometer", 19, 5200, {"lowerNonCritical": 700, "lowerCritical": 500}))
        nodes = []
        for index in range(count):
            kind, unit, reading, limits = kinds[index % 3]
            chip, sensor = divmod(index, per_chip)
            nodes.append({"type": kind, "path": f"/rack/board{chip}/{kind}{sensor}",
                          "description": f"Board {chip} {kind} {sensor}", "status": NORMAL,
                          "possibleStates": [1, 22, 23, 25, 26], "baseUnits": unit,
                          "reading": reading, **limits})
        return cls(nodes)

    def nodes(self):
        """Returns copies of the nodes."""
        return [dict(node) for node in self._nodes.values()]

    def write(self, file):
        """Replaces a model file."""
        new = pathlib.Path(f"{file}.new")
        new.write_text(json.dumps({"nodes": self.nodes()}))
        new.rename(file)

    @contextlib.contextmanager
    def changes(self):
        """Makes one change of all that happens meanwhile."""
        on_change, self.on_change = self.on_change, lambda: None
        try:
            yield
        finally:
            self.on_change = on_change
        on_change()

    def set_reading(self, path, reading):
        """Sets a reading and the state that follows from it."""
        self._nodes[path]["reading"] = reading
        self._nodes[path]["status"] = status_of(self._nodes[path])
        self.on_change()

    def lose(self, path):
        """Ends the communication with a sensor."""
        del self._nodes[path]["reading"]
        self._nodes[path]["status"] = LOST
        self.on_change()

    def change_temperatures(self, count, reading):
        """Changes the readings of the first temperatures. Returns their identifiers."""
        nodes = [node for node in self._nodes.values() if node["type"] == "temperature"][:count]
        for index, node in enumerate(nodes):
            node["reading"] = reading + index % 2 / 100
        self.on_change()
        return [f"{node['description']}:{node['path']}" for node in nodes]

    def remove_chip(self, folder):
        """Removes a chip and returns its nodes, for `add`."""
        removed = [node for path, node in self._nodes.items() if path.rsplit("/", 1)[0] == folder]
        for node in removed:
            del self._nodes[node["path"]]
        self.on_change()
        return removed

    def add(self, nodes):
        """Adds nodes."""
        self._nodes.update({node["path"]: dict(node) for node in nodes})
        self.on_change()
