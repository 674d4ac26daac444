# Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

"""A server of the page for tests of the browser's side, until `sensorctl serve` has its routes."""

import html
import http.server
import json
import math
import mimetypes
import pathlib
import re
import select
import socket
import threading
import time
import urllib.parse

from machine import ROOT

POLICY = ("default-src 'none'; script-src 'self'; style-src 'self'; connect-src 'self'; "
          "img-src 'self'; base-uri 'none'; form-action 'self'; frame-ancestors 'none'")
LANGUAGES = ("en", "de", "fr", "es", "ja")
DYGRAPHS = pathlib.Path("/usr/share/javascript/dygraphs")
STATES = {1: "Normal", 5: "Failing soon", 12: "No contact", 13: "Lost", 16: "Disabled",
          21: "Warning", 22: "Warning low", 23: "Warning high", 25: "Critical low",
          26: "Critical high"}
URGENCIES = ("critical", "warning", "lost", "unknown", "inactive", "normal")
KINDS = {"temperature": ("temperature", "°C"), "voltage": ("voltage", "V"),
         "tachometer": ("fan", "RPM")}
LIMITS = {"lowerNonCritical": "lowWarning", "lowerCritical": "lowCritical",
          "lowerFatal": "lowFatal", "upperNonCritical": "highWarning",
          "upperCritical": "highCritical", "upperFatal": "highFatal"}
INTERVALS = {"hour": 10, "day": 60}
SAMPLES = {"hour": 360, "day": 1440}


def urgency_of(state):
    """Returns the urgency of a state's word."""
    word = state.split()[0].lower()
    return {"failing": "warning", "no": "lost", "disabled": "inactive"}.get(word, word)


def sensor_of(node):
    """Returns the object of `/api/sensors` for a node."""
    kind, unit = KINDS[node["type"]]
    label = node["description"]
    return {"chip": node["path"].removeprefix("/hwmon").strip("/").rsplit("/", 1)[0], "device": node.get("device"),
            "label": label, "kind": kind, "value": node.get("reading"), "unit": unit,
            "state": STATES[node["status"]],
            "limits": {LIMITS[name]: node[name] for name in LIMITS if name in node},
            "deviceId": f"{label}:{node['path']}"}


def natural(text):
    """Returns a key by which "temp2" comes before "temp10"."""
    return [(0, int(part), "") if part.isdigit() else (1, 0, part)
            for part in re.split(r"(\d+)", text.lower()) if part]


PLACE = re.compile(r"\{\{#(\w+)\}\}(.*?)\{\{/\1\}\}|\{\{([\w.]+)\}\}", re.S)


def render(template, places):
    """Fills the template in one pass: lists repeat their sections, texts are escaped."""
    def fill(match):
        section, inner, place = match.groups()
        if section is None:
            return html.escape(str(places[place]))
        return "".join(render(inner, {**places, **item}) for item in places[section])
    return PLACE.sub(fill, template)


class StandIn:
    """Serves a machine on a port of the loopback address."""

    def __init__(self, machine, past=lambda node, age: node.get("reading")):
        self.machine = machine
        self.past = past
        self.port = 0
        self.event_streams = 0
        self.keeps_history = True
        self.changed = threading.Condition()
        machine.on_change = self._notify

    @property
    def address(self):
        """Returns the page's address."""
        return f"http://127.0.0.1:{self.port}/"

    def start(self):
        """Starts the server, on the port that it had before."""
        self.is_running = True
        self.connections = set()
        handler = type("Handler", (Handler,), {"server_of": self})
        self.server = http.server.ThreadingHTTPServer(("127.0.0.1", self.port), handler)
        self.server.daemon_threads = True
        self.port = self.server.server_port
        threading.Thread(target=self.server.serve_forever, args=(0.05,), daemon=True).start()
        return self

    def stop(self):
        """Ends the server and its connections."""
        self.is_running = False
        self._notify()
        self.server.shutdown()
        self.server.server_close()
        for connection in list(self.connections):
            try:
                connection.shutdown(socket.SHUT_RDWR)
            except OSError:
                pass

    def restart(self, pause=0):
        """Stops the server and starts it again."""
        self.stop()
        time.sleep(pause)
        self.start()

    def sensors(self):
        """Returns the document of `/api/sensors`."""
        return sorted((sensor_of(node) for node in self.machine.nodes()),
                      key=lambda each: (natural(each["chip"]), natural(each["label"])))

    def history(self, span, devices, points):
        """Returns the document of `/api/history`; None for an unknown device."""
        nodes = {sensor_of(node)["deviceId"]: node for node in self.machine.nodes()}
        if any(device not in nodes for device in devices):
            return None
        interval = INTERVALS[span]
        count = SAMPLES[span]
        if points:
            interval, count = interval * count // points, points
        result = []
        for device in devices or nodes:
            node = nodes[device]
            values = [self.past(node, (count - index) * interval) for index in range(count)]
            entry = {"deviceId": device, "states": self._states(node, values)}
            if span == "day":
                spread = [None if value is None else abs(value) * 0.02 for value in values]
                entry["minimum"] = [None if v is None else v - s for v, s in zip(values, spread)]
                entry["mean"] = values
                entry["maximum"] = [None if v is None else v + s for v, s in zip(values, spread)]
            else:
                entry["values"] = values
            result.append(entry)
        return {"span": span, "interval": interval, "end": int(time.time()), "sensors": result}

    def _states(self, node, values):
        from machine import status_of
        runs = []
        for value in values:
            state = sensor_of(node)["state"] if value is None else STATES[
                status_of({**node, "reading": value})]
            if runs and runs[-1][0] == state:
                runs[-1][1] += 1
            else:
                runs.append([state, 1])
        if runs[-1][0] != sensor_of(node)["state"]:
            runs[-1][1] -= 1
            runs.append([sensor_of(node)["state"], 1])
        return runs

    def page(self, language):
        """Returns the page with its table."""
        dictionary = json.loads((ROOT / f"web/languages/{language}.json").read_text())
        sensors = self.sensors()
        chips = {}
        for sensor in sensors:
            limits = ", ".join(f"{dictionary['limitNames'][name]} {value}"
                               for name, value in sensor["limits"].items())
            reading = "–" if sensor["value"] is None else f"{sensor['value']} {sensor['unit']}"
            chips.setdefault(sensor["chip"], []).append({
                "label": sensor["label"], "reading": reading, "limits": limits,
                "state": dictionary["states"][sensor["state"]],
                "urgency": urgency_of(sensor["state"])})
        numbers = {each: sum(urgency_of(s["state"]) == each for s in sensors) for each in URGENCIES}
        texts = {f"text.{name}": text for name, text in dictionary.items()}
        return render((ROOT / "web/page.html").read_text(), {
            **texts, "language": language, "machine": "web07.example",
            "counts": [{"urgency": each, "number": number, "word": dictionary["urgencies"][each]}
                       for each, number in numbers.items()],
            "chips": [{"chip": chip, "device": "", "sensors": rows}
                      for chip, rows in chips.items()]})

    def _notify(self):
        with self.changed:
            self.changed.notify_all()


class Handler(http.server.BaseHTTPRequestHandler):
    """One connection."""

    protocol_version = "HTTP/1.1"
    server_of = None

    def setup(self):
        super().setup()
        self.server_of.connections.add(self.connection)

    def finish(self):
        self.server_of.connections.discard(self.connection)
        try:
            super().finish()
        except OSError:
            pass

    def log_message(self, *_):
        pass

    def do_GET(self):  # pylint: disable=invalid-name
        """Answers a request."""
        url = urllib.parse.urlsplit(self.path)
        query = urllib.parse.parse_qs(url.query)
        try:
            if url.path == "/":
                accepted = self.headers.get("Accept-Language", "en")[:2]
                language = accepted if accepted in LANGUAGES else "en"
                self._answer(self.server_of.page(language), "text/html; charset=utf-8")
            elif url.path == "/api/sensors":
                self._json(self.server_of.sensors())
            elif url.path == "/api/history":
                self._history(query)
            elif url.path == "/api/events":
                self._events()
            elif url.path.startswith("/web/"):
                self._file(url.path[len("/web/"):])
            else:
                self._json({"error": "not found"}, 404)
        except OSError:
            self.close_connection = True

    def _history(self, query):
        span = query.get("span", [""])[0]
        if not self.server_of.keeps_history:
            return self._json({"error": "no history is kept"}, 404)
        devices, points = query.get("device", []), query.get("points", ["0"])[0]
        if span not in INTERVALS or points not in ("0", "60") or (points == "0" and not devices):
            return self._json({"error": "a parameter is wrong"}, 400)
        document = self.server_of.history(span, devices, int(points))
        if document is None:
            return self._json({"error": "there is no such device"}, 404)
        return self._json(document)

    def _events(self):
        self._head(200, "text/event-stream")
        self.close_connection = True
        self.server_of.event_streams += 1
        try:
            self._send_events(self.server_of)
        finally:
            self.server_of.event_streams -= 1

    def _send_events(self, server):
        known = server.sensors()
        self._event("sensors", known)
        alive = time.time()
        while server.is_running:
            with server.changed:
                server.changed.wait(1)
            if select.select([self.connection], [], [], 0.2)[0]:
                return  # the browser has closed the connection
            now = server.sensors()
            if now != known:
                before = {sensor["deviceId"]: sensor for sensor in known}
                after = {sensor["deviceId"]: sensor for sensor in now}
                self._event("changes", {
                    "time": int(time.time()),
                    "sensors": [each for key, each in after.items() if each != before.get(key)],
                    "gone": [key for key in before if key not in after]})
                known = now
            elif time.time() > alive + 15:
                alive = time.time()
                self._event("alive", {"time": int(alive)})

    def _event(self, name, data):
        self.wfile.write(f"event: {name}\ndata: {json.dumps(data)}\n\n".encode())
        self.wfile.flush()

    def _file(self, name):
        folder = DYGRAPHS if name.startswith("dygraph") else ROOT / "web"
        path = (folder / name).resolve()
        if folder not in path.parents or not path.is_file():
            return self._json({"error": "not found"}, 404)
        return self._answer(path.read_bytes(), mimetypes.guess_type(name)[0])

    def _json(self, document, status=200):
        self._answer(json.dumps(document), "application/json", status)

    def _answer(self, body, media_type, status=200):
        content = body.encode() if isinstance(body, str) else body
        self._head(status, media_type, len(content))
        self.wfile.write(content)

    def _head(self, status, media_type, length=None):
        self.send_response(status)
        self.send_header("Content-Type", media_type)
        self.send_header("Content-Security-Policy", POLICY)
        self.send_header("X-Content-Type-Options", "nosniff")
        self.send_header("Cache-Control", "no-cache")
        if length is None:
            self.send_header("Connection", "close")
        else:
            self.send_header("Content-Length", str(length))
        self.end_headers()


def wave(node, age):
    """Returns a made-up reading of the past, which moves as real ones do."""
    if "reading" not in node:
        return None
    seed = sum(node["path"].encode())
    swing = 0.01 if node["type"] == "voltage" else 0.06
    drift = math.sin((age / 700) + seed) + 0.4 * math.sin(age / 97 + 3 * seed)
    start = math.sin(seed) + 0.4 * math.sin(3 * seed)
    return round(node["reading"] * (1 + swing * (drift - start)), 3)
