# Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

"""The search, its selectors and the address."""

import ctypes
import json
import random
import subprocess

from selenium.webdriver.common.keys import Keys

from browser import PageTest
from machine import Machine
from served import SENSORCTL, demonstration

VISIBLE = ("[...document.querySelectorAll('.chips .sensor:not([hidden])')]"
           ".map(row => row.querySelector('button').textContent)")


class SearchTest(PageTest):
    def setUp(self):
        super().setUp()
        self.server = demonstration()

    def selected_at_the_terminal(self, server, selector):
        """Returns the labels of the sensors that `sensorctl` selects."""
        listed = subprocess.run(
            [SENSORCTL, "list", "--json", "--model", server.model, selector],
            capture_output=True, check=False).stdout
        return {sensor["label"] for sensor in json.loads(listed or "[]")}

    def selected(self, selector):
        """Returns the labels of the sensors that the page selects."""
        return self.driver.execute_async_script(
            "const [selector, done] = arguments;"
            "const rows = [...document.querySelectorAll('.chips .sensor')];"
            "import('/web/Selectors.js').then(({namesOf, selectorOf}) => done(rows.filter(row =>"
            "    selectorOf(selector)(namesOf({deviceId: row.dataset.device,"
            "        label: row.querySelector('button').textContent,"
            "        chip: row.closest('.chip').querySelector('.chip-title').textContent})))"
            "    .map(row => row.querySelector('button').textContent)));", selector)

    def found(self, text):
        self.search(text)
        return self.run_script(VISIBLE)

    def test_finds_what_the_terminal_selects(self):
        self.open(self.server)
        for text, labels in {
                "SYSTEM/PSU1": ["PSU 1 Fan", "PSU 1 Input", "PSU 1 Temp"],
                '"psu 1 fan"': ["PSU 1 Fan"],
                "system/psu1/vin": ["PSU 1 Input"],
                "*/psu?/fan": ["PSU 1 Fan", "PSU 2 Fan"],
                "/system/nvme[!1]/*": ["NVMe 2 Temp"],
                "PSU*Fan:/system/psu1/fan": ["PSU 1 Fan"],
                "kind:voltage *psu*": ["PSU 1 Input", "PSU 2 Input"],
                "system/nvme1 system/nvme2": ["NVMe 1 Temp", "NVMe 2 Temp"],
                "package cpu": ["CPU 1 Package Temp", "CPU 2 Package Temp"],
                "nowhere": []}.items():
            with self.subTest(text):
                self.assertEqual(labels, self.found(text))
        # What follows has one word, which the terminal takes, too.
        for selector in ("system/psu1", "PSU 1 FAN", "[pn]su[[:digit:]]", "*fan[!1-3]", "vbat", "*",
                         "CPU 1 Package Temp:/system/cpu1/package", "/system/cpu?/*"):
            with self.subTest(selector):
                self.assertEqual(self.selected_at_the_terminal(self.server, selector),
                                 set(self.selected(selector)))
        self.search("nowhere")
        self.assertEqual("Shown: 0", self.run_script("document.querySelector('#found').innerText"))
        self.assertTrue(self.driver.find_element("class name", "none").is_displayed())
        self.search("nvme 1")
        self.assertEqual(["system/nvme1"], self.run_script(
            "[...document.querySelectorAll('.chip:not([hidden]) .chip-title')]"
            ".map(title => title.textContent)"))
        self.assertFalse(self.driver.find_element("class name", "none").is_displayed())

    def test_selects_by_addresses_blanks_and_exact_names_as_the_terminal_does(self):
        server = self.serve(Machine([
            {"type": "voltage", "path": path, "description": label, "status": 1, "reading": 1}
            for path, label in (
                ("/hwmon/nct6775-isa-0290/in0", "Vcore"), ("/hwmon/jc42-i2c-1-001a/in0", "Bus"),
                ("/hwmon/w-ISA-0290/in0", "Capital"), ("/rack/board-0a/t", "Board"),
                ("/rack/x/temp2", "Blank "), ("/rack/x/temp3", "A[1]"), ("/rack/x/temp4", "A1"),
                ("/rack/x/temp5", "ΟΔΟΣ"))]))
        self.open(server)
        for selector, labels in {
                "nct6775-isa-290": {"Vcore"}, "nct6775-isa-0x0290": {"Vcore"},
                "*-isa-290": {"Vcore"}, "nct6775-*-290": {"Vcore"},
                "nct6775-*-00290": set(), "jc42-i2c-*-1A": {"Bus"}, "jc42-i2c-1-1a": {"Bus"},
                "w-isa-290": set(), "w-isa-0290": {"Capital"},
                "rack/board-a": set(), "rack/board-0a": {"Board"}, "temp2": {"Blank"},
                "/rack/x/temp2": {"Blank"}, "rack/x/temp2": {"Blank"}, "blank": {"Blank"},
                "Blank :/rack/x/temp2": {"Blank"}, "a[1]": {"A1", "A[1]"}, "οδοσ": {"ΟΔΟΣ"},
                "οδος": set()}.items():
            with self.subTest(selector):
                self.assertEqual(labels, self.selected_at_the_terminal(server, selector))
                self.assertEqual(labels, set(self.selected(selector)))

    def test_keeps_in_the_address_what_is_shown(self):
        self.open(self.server)
        self.driver.find_element("name", "search").send_keys("kind:fan")
        self.driver.find_element("name", "problems").click()
        problems = ["System Fan 4", "PSU 2 Fan"]
        self.assertEqual(problems, self.run_script(VISIBLE))
        self.driver.get(self.driver.current_url)
        self.wait_for(f"{VISIBLE}.length === 2")
        self.assertEqual(problems, self.run_script(VISIBLE))
        field = self.driver.find_element("name", "search")
        self.assertEqual("kind:fan", field.get_property("value"))
        self.driver.find_element("name", "problems").click()
        field.send_keys(Keys.ESCAPE)
        self.assertEqual(40, len(self.run_script(VISIBLE)))

    def test_matches_patterns_as_the_c_library_does(self):
        self.open(self.server)
        library = ctypes.CDLL(None)
        no_escape, fold_case = 2, 16
        picks = random.Random(15)
        cases = [("".join(picks.choices("ab-]/.B*?[!^\\(", k=picks.randint(1, 7))),
                  "".join(picks.choices("ab-]/.B\\(", k=picks.randint(0, 5)))) for _ in range(4000)]
        cases += [("[]]", "]"), ("[!]a]", "b"), ("[a-c]*", "b/x"), ("[", "["), ("[a", "[a"),
                  ("*.*", "a.b"), ("a?", "ab"), ("[z-a]", "z"), ("[^a]", "b"), ("ä*", "äb"),
                  ("[&]", "&"), ("fan[[:digit:]]", "fan1"), ("fan[![:digit:]]", "fan1"),
                  ("[[:digit:]a]", "a"), ("[[:x:]]", "x"), ("*?" * 12 + "zz", "a" * 40)]
        expected = [library.fnmatch(pattern.encode(), name.encode(), no_escape | fold_case) == 0
                    for pattern, name in cases]
        actual = self.driver.execute_async_script(
            "const [cases, done] = arguments;"
            "import('/web/Selectors.js').then(({matcherOf}) => done(cases.map("
            "([pattern, name]) => matcherOf(pattern)(name.toLowerCase()))));", cases)
        self.assertGreater(sum(expected), 50)
        self.assertEqual([], [(case, isMatch) for case, isMatch, is_same in zip(
            cases, expected, map(bool.__eq__, expected, actual)) if not is_same])
