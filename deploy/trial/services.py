# Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

"""The processes of the trial."""

import subprocess


class Services:
    """Starts processes and ends them. Each writes to a log file of its name."""

    def __init__(self, logs):
        self._logs = logs
        self._processes = {}

    def start(self, name, command):
        with open(self._logs / f"{name}.log", "ab") as log:
            # Ctrl-C is for the trial alone, which ends them in order.
            self._processes[name] = subprocess.Popen(
                list(map(str, command)),
                stdin=subprocess.DEVNULL,
                stdout=log,
                stderr=log,
                start_new_session=True,
            )

    def pid(self, name):
        return self._processes[name].pid

    def is_running(self, name):
        return name in self._processes

    def failure(self):
        """Returns a text about a process that has ended by itself, None when there is none."""
        for name, process in self._processes.items():
            if process.poll() is not None:
                log = (self._logs / f"{name}.log").read_text(errors="replace")
                return f"{name} ended with {process.returncode}\n{log[-2000:]}"
        return None

    def stop(self, *names):
        """Ends the processes of these names; without names, all of them."""
        stopped = [self._processes.pop(name) for name in names or list(self._processes)]
        for process in stopped:
            process.terminate()
        for process in stopped:
            try:
                process.wait(10)
            except subprocess.TimeoutExpired:
                process.kill()
                process.wait()

    def kill(self, name):
        process = self._processes.pop(name)
        process.kill()
        process.wait()
