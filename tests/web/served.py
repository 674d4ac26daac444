# Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

"""`sensorctl serve` with a machine that a test changes."""

import atexit
import functools
import math
import os
import pathlib
import re
import subprocess
import tempfile

from history_file import write_history
from machine import Machine

SENSORCTL = os.environ["SENSOR_PROFILE_SENSORCTL"]
ESTABLISHED = "01"  # in /proc/net/tcp


class Server:
    """
    Serves a machine on a port of the loopback address, with a history: `past` returns the reading
    of a node some seconds ago; without it, the history begins now. Follows the changes of the
    machine.
    """

    def __init__(self, machine, past=None, is_history_kept=True):
        self.machine = machine
        self.port = 0
        self.process = None
        self.is_history_kept = is_history_kept
        self.folder = tempfile.TemporaryDirectory()  # pylint: disable=consider-using-with
        atexit.register(self.folder.cleanup)
        self.model = pathlib.Path(self.folder.name) / "model.json"
        machine.on_change = lambda: machine.write(self.model)
        machine.on_change()
        if past:
            write_history(f"{self.folder.name}/history", machine.nodes(), past)

    @property
    def address(self):
        """Returns the page's address."""
        return f"http://127.0.0.1:{self.port}/"

    @property
    def event_streams(self):
        """Returns the number of streams. Other connections are closed after a second."""
        with open("/proc/net/tcp", encoding="ascii") as connections:
            rows = [line.split() for line in connections]
        return sum(row[1].endswith(f":{self.port:04X}") and row[3] == ESTABLISHED for row in rows)

    def start(self):
        """Starts the server, on the port that it had before."""
        self.process = subprocess.Popen(  # pylint: disable=consider-using-with
            [SENSORCTL, "serve", "--model", self.model, "--address", "127.0.0.1",
             "--port", str(self.port), "--idle-timeout", "1",
             "--history", self.folder.name if self.is_history_kept else "off",
             *(["--user", "root"] if os.geteuid() == 0 else [])],
            stdout=subprocess.PIPE, stderr=subprocess.DEVNULL, text=True)
        self.port = int(re.search(r":(\d+)$", self.process.stdout.readline())[1])
        return self

    def stop(self):
        """Ends the server."""
        self.process.terminate()
        self.process.communicate(timeout=10)


def wave(node, age):
    """Returns a made-up reading of the past, which moves as real ones do."""
    if "reading" not in node:
        return None
    seed = sum(node["path"].encode())
    swing = 0.01 if node["type"] == "voltage" else 0.06
    drift = math.sin((age / 700) + seed) + 0.4 * math.sin(age / 97 + 3 * seed)
    start = math.sin(seed) + 0.4 * math.sin(3 * seed)
    return round(node["reading"] * (1 + swing * (drift - start)), 3)


@functools.cache
def demonstration():
    """Returns the one server for all tests that do not change the machine."""
    server = Server(Machine.demonstration(), past=wave).start()
    atexit.register(server.stop)
    return server
