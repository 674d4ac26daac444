# Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

"""The interface of the page, by the OpenAPI file that describes it."""

import json
import subprocess
import unittest
import urllib.error
import urllib.parse
import urllib.request

import jsonschema
import yaml

from browser import npm_file
from machine import ROOT, Machine
from served import Server, demonstration

FILE = ROOT / "schema/sensor-profile-api.openapi.yaml"
FAN = "PSU 1 Fan:/system/psu1/fan"


def bundled():
    """Returns the OpenAPI document with the schema of the list in the place of its file's name."""
    name = "sensorctl-list.schema.json"
    reference = "#/components/schemas/List"
    text = FILE.read_text().replace(f"{name}#", reference).replace(f"'{name}'", f"'{reference}'")
    document = yaml.safe_load(text)
    listed = json.loads((ROOT / "schema" / name).read_text())
    del listed["$id"], listed["$schema"]
    document["components"]["schemas"]["List"] = listed
    return document


class ApiTest(unittest.TestCase):
    def setUp(self):
        self.document = bundled()
        self.server = demonstration()

    def check(self, value, schema):
        """Checks a value by a schema in the OpenAPI file."""
        resolver = jsonschema.RefResolver("", self.document)
        jsonschema.Draft202012Validator(schema, resolver=resolver).validate(value)

    def schema_of(self, path, status):
        answer = self.document["paths"][path]["get"]["responses"][str(status)]
        return answer["content"]["application/json"]["schema"]

    def ask(self, path, *parameters):
        """Returns the status and the document of an answer, which the OpenAPI file describes."""
        url = self.server.address[:-1] + path + "?" + urllib.parse.urlencode(parameters)
        try:
            with urllib.request.urlopen(url, timeout=10) as answer:
                status, document = answer.status, json.load(answer)
        except urllib.error.HTTPError as error:
            with error:
                status, document = error.code, json.load(error)
        self.check(document, self.schema_of(path, status))
        return status, document

    def test_file_is_an_openapi_document(self):
        npm_file(self, "@seriousme/openapi-schema-validator/package.json")
        validator = npm_file(self, ".bin/validate-api")
        result = subprocess.run([validator, "/dev/stdin"], input=json.dumps(self.document),
                                capture_output=True, text=True, check=False)
        self.assertEqual(0, result.returncode, result.stdout + result.stderr)

    def test_lists_the_sensors(self):
        status, sensors = self.ask("/api/sensors")
        self.assertEqual((200, 40), (status, len(sensors)))

    def test_tells_the_last_hour_and_day(self):
        for span, names in (("hour", ["values"]), ("day", ["minimum", "mean", "maximum"])):
            status, history = self.ask("/api/history", ("span", span), ("device", FAN))
            self.assertEqual(200, status)
            (sensor,) = history["sensors"]
            for name in names:
                self.assertEqual(sum(count for _, count in sensor["states"]), len(sensor[name]))

    def test_tells_a_thinned_hour_of_all_sensors(self):
        _, history = self.ask("/api/history", ("span", "hour"), ("points", 60))
        self.assertEqual(40, len(history["sensors"]))
        self.assertEqual({60}, {len(sensor["values"]) for sensor in history["sensors"]})

    def test_refuses_wrong_parameters(self):
        for parameters in ((), (("span", "week"),), (("span", "day"),),
                           (("span", "hour"), ("points", "x"))):
            with self.subTest(parameters):
                self.assertEqual(400, self.ask("/api/history", *parameters)[0])

    def test_knows_no_history_of_an_unknown_device(self):
        self.assertEqual(404, self.ask("/api/history", ("span", "hour"), ("device", "none"))[0])

    def test_sends_the_list_the_lost_sources_and_then_changes(self):
        machine = Machine.demonstration()
        server = Server(machine).start()
        self.addCleanup(server.stop)
        schemas = {"sensors": {"$ref": "#/components/schemas/List"},
                   "sources": {"$ref": "#/components/schemas/Sources"},
                   "changes": {"$ref": "#/components/schemas/Changes"}}
        with urllib.request.urlopen(server.address + "api/events", timeout=10) as answer:
            self.assertEqual("text/event-stream", answer.headers.get_content_type())
            for expected in schemas:
                lines = []
                while (line := answer.readline().decode().strip()) or not lines:
                    lines.append(line)
                event = dict(line.split(": ", 1) for line in lines if line)
                self.assertEqual(expected, event["event"])
                data = json.loads(event["data"])
                self.check(data, schemas[expected])
                machine.remove_chip("/system/psu1")
        self.assertIn(FAN, data["gone"])
