# Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

"""A fleet on loopback addresses: servers, Prometheus, Alertmanager and VictoriaMetrics."""

import json
import pathlib
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
    first_port: int = 9090
    speed: float = 60
    interval: int = 5
    rule_interval: int = 5
    has_incidents: bool = True


class Failure(Exception):
    """A part of the trial that failed."""


class Fleet:
    """Starts a fleet, moves its sensors, and ends it."""

    def __init__(self, options, on_message):
        self.options = options
        self.ports = Ports(*range(options.first_port, options.first_port + len(Ports._fields)))
        self.folder = options.folder
        # The servers, which do not stay root, read the models.
        self.folder.chmod(0o755)
        for name in ("logs", "models"):
            (self.folder / name).mkdir(exist_ok=True)
        self.racks = self._make_racks()
        self.machines = [machine for rack in self.racks for machine in rack]
        self.incidents = incidents_of(self.racks) if options.has_incidents else []
        self.services = Services(self.folder / "logs")
        configuration.write_all(self.folder, options, self.ports, self.racks)
        credentials.make(self.folder)
        try:
            self.receiver = Receiver(self.ports.receiver, on_message)
        except OSError as error:
            raise Failure(f"port {self.ports.receiver}: {error.strerror}") from error
        self._begin = time.monotonic()
        self._moved = 0.0

    def start(self):
        """Starts everything, waits until it is ready, and lets the time of the trial begin."""
        self._renew_models()
        for machine in self.machines:
            self.start_machine(machine)
        self.services.start(
            "victoria-metrics",
            [
                "victoria-metrics",
                f"-storageDataPath={self.folder}/victoria-metrics",
                f"-httpListenAddr=127.0.0.1:{self.ports.victoria_metrics}",
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
        self.services.stop()
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
                with urllib.request.urlopen(f"http://127.0.0.1:{port}{path}", timeout=5):
                    return
            except OSError:
                time.sleep(0.1)
        raise Failure(f"nothing is ready at port {port}")


def name_of(machine):
    return f"machine-{machine.number}"


def get_json(port, path):
    """Returns the data of an answer of the interface of Prometheus."""
    with urllib.request.urlopen(f"http://127.0.0.1:{port}{path}", timeout=30) as response:
        return json.load(response)["data"]
