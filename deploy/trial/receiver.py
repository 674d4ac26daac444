# Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

"""The receiver of Alertmanager's messages."""

import json
import threading
from collections import Counter
from dataclasses import dataclass
from http.server import BaseHTTPRequestHandler, ThreadingHTTPServer


@dataclass(frozen=True)
class Message:
    """A message of Alertmanager about a group of alerts."""

    receiver: str
    status: str
    group: dict
    alerts: list

    @property
    def alerts_by_name(self):
        """The alerts in lists by their name."""
        names = {}
        for alert in self.alerts:
            names.setdefault(alert["labels"]["alertname"], []).append(alert)
        return names

    def __str__(self):
        alerts = ", ".join(
            f"{count} {name} {status}"
            for name, alerts in self.alerts_by_name.items()
            for status, count in Counter(each["status"] for each in alerts).items()
        )
        group = " ".join(f"{name}={value}" for name, value in sorted(self.group.items()))
        return f"message to {self.receiver} ({group}): {alerts}"


class Receiver:
    """Keeps the messages that it gets, and passes them to a function."""

    def __init__(self, port, on_message):
        self.messages = []

        class Handler(BaseHTTPRequestHandler):
            def do_POST(handler):
                body = json.loads(handler.rfile.read(int(handler.headers["Content-Length"])))
                message = Message(
                    body["receiver"], body["status"], body["groupLabels"], body["alerts"]
                )
                self.messages.append(message)
                on_message(message)
                handler.send_response(200)
                handler.send_header("Content-Length", "0")
                handler.end_headers()

            def log_message(handler, *_):
                pass

        self._server = ThreadingHTTPServer(("127.0.0.1", port), Handler)
        threading.Thread(target=self._server.serve_forever, daemon=True).start()

    def close(self):
        self._server.shutdown()
        self._server.server_close()
