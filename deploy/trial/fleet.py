# Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

"""A fleet on loopback addresses: servers, Prometheus, Alertmanager and VictoriaMetrics."""

import contextlib
import json
import os
import pathlib
import signal
import socket
import tempfile
import time
import urllib.parse
import urllib.request
from dataclasses import dataclass
from typing import NamedTuple

from trial import configuration, credentials
from trial.incidents import SwitchedOff, incidents_of
from trial.machine import Machine
from trial.receiver import Receiver
from trial.services import Services

RACKS = 5
DAEMONS = ("prometheus", "prometheus-alertmanager", "victoria-metrics")
ENDING_SIGNALS = (signal.SIGINT, signal.SIGTERM, signal.SIGHUP)
# Loopback addresses have no proxy.
OPENER = urllib.request.build_opener(urllib.request.ProxyHandler({}))


class Ports(NamedTuple):
    """The ports of the programs; all machines have the same one."""

    prometheus: int
    alertmanager: int
    victoria_metrics: int
    receiver: int
    machine: int


@dataclass(frozen=True)
class Options:
    """What a trial may vary. Intervals are in seconds."""

    folder: pathlib.Path
    sensorctl: pathlib.Path
    machines: int = 50
    first_port: int = 19090
    speed: float = 60
    interval: int = 5
    rule_interval: int = 5
    has_incidents: bool = True
    keeps_history: bool = True


class Failure(Exception):
    """A part of the trial that failed."""


class Fleet:
    """Starts a fleet, moves its sensors, and ends it.

    `on_message` is called with the minute and the message that Alertmanager has sent.
    """

    def __init__(self, options, on_message):
        self.options = options
        self.ports = Ports(*range(options.first_port, options.first_port + len(Ports._fields)))
        for port in self.ports:
            check_is_free(port)
        self.folder = options.folder
        for name in ("logs", "models"):
            (self.folder / name).mkdir(exist_ok=True)
        # The servers, which do not stay root, read the models.
        (self.folder / "models").chmod(0o755)
        self.racks = self._make_racks()
        self.machines = [machine for rack in self.racks for machine in rack]
        self.incidents = incidents_of(self.racks) if options.has_incidents else []
        self.services = Services(self.folder / "logs")
        configuration.write_all(self.folder, options, self.ports, self.racks)
        credentials.make(self.folder)
        self._begin = time.monotonic()
        self._moved = 0.0
        self.receiver = Receiver(
            self.ports.receiver, lambda message: on_message(self.minute, message)
        )

    def start(self):
        """Starts everything, waits until it is ready, and lets the time of the trial begin."""
        self._renew_models()
        for machine in self.machines:
            self.start_machine(machine)
        self.services.start(
            "victoria-metrics",
            [
                "victoria-metrics",
                *configuration.victoria_metrics(self.folder, self.ports, self.options.interval),
                "-search.latencyOffset=1s",
                "-loggerLevel=WARN",
            ],
        )
        self.services.start(
            "prometheus-alertmanager",
            [
                "prometheus-alertmanager",
                f"--config.file={self.folder}/alertmanager.yml",
                f"--storage.path={self.folder}/alertmanager",
                f"--web.listen-address=127.0.0.1:{self.ports.alertmanager}",
                "--cluster.listen-address=",
                "--log.level=warn",
            ],
        )
        self._wait_for(self.ports.victoria_metrics, "/health")
        self._wait_for(self.ports.alertmanager, "/-/ready")
        self.start_prometheus()
        self._begin = time.monotonic()

    def start_prometheus(self):
        self.services.start(
            "prometheus",
            [
                "prometheus",
                f"--config.file={self.folder}/prometheus.yml",
                f"--storage.tsdb.path={self.folder}/prometheus",
                f"--web.listen-address=127.0.0.1:{self.ports.prometheus}",
                "--web.enable-admin-api",
                "--log.level=warn",
            ],
        )
        self._wait_for(self.ports.prometheus, "/-/ready")

    def start_machine(self, machine):
        command = [self.options.sensorctl, "serve", "--model", machine.model]
        command += ["--address", machine.address, "--port", "0", "--tls-port", self.ports.machine]
        for name in ("certificate", "key", "passwords"):
            command += [f"--{name}", self.folder / f"{name}.pem"]
        if not self.options.keeps_history:
            command += ["--history", "off"]
        self.services.start(name_of(machine), command)

    @property
    def minute(self):
        """The minutes since the start, in the time of the trial."""
        return (time.monotonic() - self._begin) * self.options.speed / 60

    def move(self):
        """Renews the model files when it is time, and switches machines off and on."""
        if time.monotonic() - self._moved >= self.options.interval:
            self._renew_models()
        for incident in self.incidents:
            if isinstance(incident, SwitchedOff):
                for machine in incident.machines:
                    self._switch(machine, incident.is_on(self.minute))

    def check(self):
        """Raises Failure where a process has ended by itself."""
        if text := self.services.failure():
            raise Failure(text)

    def stop(self):
        # While it ends, Prometheus sends its last samples to VictoriaMetrics.
        if self.services.is_running("prometheus"):
            self.services.stop("prometheus")
        self.services.close()
        self.receiver.close()

    def query(self, expression, at=None, port=None):
        """Returns the result of an expression of PromQL, in Prometheus unless a port is given."""
        values = {"query": expression} | ({"time": at} if at else {})
        path = "/api/v1/query?" + urllib.parse.urlencode(values)
        return get_json(port or self.ports.prometheus, path)["result"]

    def _renew_models(self):
        self._moved = time.monotonic()
        for machine in self.machines:
            machine.write(self.minute, self.incidents)

    def _switch(self, machine, is_off):
        is_running = self.services.is_running(name_of(machine))
        if is_off and is_running:
            self.services.stop(name_of(machine))
        elif not is_off and not is_running:
            self.start_machine(machine)

    def _make_racks(self):
        count = self.options.machines
        racks = []
        for rack in range(RACKS):
            numbers = range(count * rack // RACKS, count * (rack + 1) // RACKS)
            racks.append(
                [
                    Machine(
                        number,
                        site="ams1" if rack < 3 else "fra1",
                        rack=f"r{rack + 1:02}",
                        address=f"127.0.{rack + 1}.{number - numbers[0] + 1}",
                        folder=self.folder / "models",
                    )
                    for number in numbers
                ]
            )
        return racks

    def _wait_for(self, port, path):
        end = time.monotonic() + 60
        while time.monotonic() < end:
            self.check()
            try:
                get(port, path)
                return
            except OSError:
                time.sleep(0.1)
        raise Failure(f"nothing is ready at port {port}")


@contextlib.contextmanager
def running(options, on_message):
    """Runs a fleet, which a signal ends in order: Ctrl-C, or a terminal that is closed."""
    for number in ENDING_SIGNALS:
        signal.signal(number, signal.default_int_handler)
    fleet = Fleet(options, on_message)
    try:
        fleet.start()
        yield fleet
    finally:
        # The end is not interrupted by a second Ctrl-C.
        for number in ENDING_SIGNALS:
            signal.signal(number, signal.SIG_IGN)
        fleet.stop()


@contextlib.contextmanager
def temporary_folder():
    """Makes a folder, in which the servers, which do not stay root, can read the models."""
    with tempfile.TemporaryDirectory(prefix="sensor-profile-") as folder:
        os.chmod(folder, 0o755)
        yield pathlib.Path(folder)


def check_is_free(port):
    """Raises Failure where a server listens at the port, such as a service of a package."""
    with socket.socket() as server:
        server.setsockopt(socket.SOL_SOCKET, socket.SO_REUSEADDR, 1)
        try:
            server.bind(("127.0.0.1", port))
        except OSError as error:
            raise Failure(f"port {port}: {error.strerror}") from error


def name_of(machine):
    return f"machine-{machine.number}"


def get(port, path, method="GET"):
    """Returns the body of an answer of a program on this machine."""
    request = urllib.request.Request(f"http://127.0.0.1:{port}{path}", method=method)
    with OPENER.open(request, timeout=30) as response:
        return response.read().decode()


def get_json(port, path, method="GET"):
    """Returns the data of an answer of the interface of Prometheus."""
    return json.loads(get(port, path, method))["data"]
