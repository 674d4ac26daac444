# Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

"""The processes of the trial."""

import subprocess
import sys

# Reads the identifier of each process when it starts, and again when it has ended. At the end of
# its input, which comes when the trial ends or is killed, it terminates the processes that are left.
GUARD = """
import contextlib, os, signal, sys
running = set()
for line in sys.stdin:
    running ^= {int(line)}
for each in running:
    with contextlib.suppress(ProcessLookupError):
        os.kill(each, signal.SIGTERM)
"""


class Services:
    """Starts processes and ends them. Each writes to a log file of its name.

    Processes do not outlive the trial, also when that is killed.
    """

    def __init__(self, logs):
        self._logs = logs
        self._processes = {}
        self._guard = subprocess.Popen(
            [sys.executable, "-c", GUARD], stdin=subprocess.PIPE, text=True, start_new_session=True
        )

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
        self._send_to_guard(self._processes[name])

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
        """Ends the processes of these names."""
        stopped = [self._processes.pop(name) for name in names]
        for process in stopped:
            process.terminate()
        for process in stopped:
            try:
                process.wait(10)
            except subprocess.TimeoutExpired:
                process.kill()
                process.wait()
            self._send_to_guard(process)

    def kill(self, name):
        process = self._processes.pop(name)
        process.kill()
        process.wait()
        self._send_to_guard(process)

    def close(self):
        """Ends all processes."""
        self.stop(*self._processes)
        self._guard.communicate()

    def _send_to_guard(self, process):
        print(process.pid, file=self._guard.stdin, flush=True)
