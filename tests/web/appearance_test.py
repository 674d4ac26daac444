# Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

"""The page on windows of all sizes, in the languages, without scripts and on paper."""

import json
import re
import subprocess

from browser import PageTest, dictionary
from machine import ROOT
from served import demonstration

LANGUAGES = ("en", "de", "fr", "es", "ja")


class AppearanceTest(PageTest):
    def setUp(self):
        super().setUp()
        self.server = demonstration()

    def test_fits_every_width_light_and_dark(self):
        self.open(self.server)
        self.wait_for("document.querySelector('.sparkline path[d^=M]')")
        for width, scheme in ((320, "light"), (375, "light"), (375, "dark"), (1280, "dark"),
                              (1280, "light"), (2560, "light"), (2560, "dark")):
            with self.subTest(width=width, scheme=scheme):
                self.look(width, 900, scheme)
                self.assertEqual(width, self.run_script("innerWidth"))
                self.assertLessEqual(
                    self.run_script("document.documentElement.scrollWidth"), width)
                if width >= 1280:
                    self.assertEqual([], self.run_script(
                        "[...document.querySelectorAll('.name button')].filter("
                        "name => name.scrollWidth > name.clientWidth).map(name => name.innerText)"))
                color = self.run_script("getComputedStyle(document.body).backgroundColor")
                brightness = sum(map(int, re.findall(r"\d+", color)))
                if scheme == "light":
                    self.assertGreater(brightness, 600)
                else:
                    self.assertLess(brightness, 150)
                self.keep_screenshot(f"page-{width}-{scheme}")

    def test_speaks_the_language_of_the_browser(self):
        for language in LANGUAGES:
            with self.subTest(language):
                self.look(language=language)
                self.open(self.server, "?device=Battery:/system/board/vbat")
                texts = dictionary(language)
                page = self.run_script("document.body.innerText")
                for text in (texts["troubles"], texts["states"]["Warning low"],
                             texts["lastHour"], texts["urgencies"]["critical"]):
                    self.assertIn(text, page)
                comma = language in ("de", "fr", "es")
                self.assertIn("2,61" if comma else "2.61", self.row_text("Battery"))
                self.keep_screenshot(f"page-{language}")

    def test_has_every_text_in_every_language(self):
        english = dictionary("en")
        schema = json.loads((ROOT / "schema/sensorctl-list.schema.json").read_text())
        self.assertEqual(schema["items"]["properties"]["state"]["enum"],
                         list(english["states"]))
        places = re.compile(r"\{\w+\}")
        for language in LANGUAGES:
            texts = dictionary(language)
            self.assertEqual(self.shape(english), self.shape(texts))
            for name, text in english.items():
                if isinstance(text, str):
                    self.assertEqual(sorted(places.findall(text)),
                                     sorted(places.findall(texts[name])), (language, name))

    def test_uses_every_text(self):
        sources = "".join(file.read_text() for pattern in (
            "web/*.js", "web/page.html", "tools/page/PageResource.cpp")
            for file in ROOT.glob(pattern))
        for name, text in dictionary("en").items():
            if isinstance(text, str):
                self.assertTrue(any(
                    form in sources for form in (f"'{name}'", f'"{name}"', f"text.{name}}}")), name)

    def test_knows_the_urgency_of_every_state(self):
        self.open(self.server)
        urgencies = self.driver.execute_async_script(
            "const [states, done] = arguments;"
            "import('/web/States.js').then(({urgencyOf}) => done(states.map(urgencyOf)));",
            [state for state in dictionary("en")["states"] if state != "Unknown"])
        self.assertNotIn("unknown", urgencies)

    def test_is_a_table_without_scripts(self):
        self.look(has_scripts=False, width=375)
        self.driver.get(self.server.address)
        self.assertLessEqual(self.run_script("document.documentElement.scrollWidth"), 375)
        table = self.driver.find_element("id", "table").text
        self.assertIn("CPU 2 DIMM D1 Temp", table)
        self.assertIn("Critical high", table)
        self.assertFalse(self.driver.find_element("id", "overview").is_displayed())
        self.assertFalse(self.driver.find_element("id", "search").is_displayed())
        self.assertIn("JavaScript", self.driver.find_element("tag name", "main").text)
        self.keep_screenshot("page-without-scripts")
        self.look(has_scripts=False, language="de")
        self.driver.get(self.server.address)
        table = self.driver.find_element("id", "table").text
        self.assertIn("2,61 V Warnung niedrig Untere Warngrenze 2,7 V", table)

    def test_prints_every_sensor_and_no_controls(self):
        self.open(self.server)
        file = self.print_to("page")
        text = subprocess.run(["pdftotext", "-layout", file, "-"], check=True,
                              capture_output=True, text=True).stdout
        for label in self.run_script("[...document.querySelectorAll('.chips button')]"
                                     ".map(button => button.textContent)"):
            self.assertIn(re.sub(r"\s", "", label), re.sub(r"\s", "", text))
        self.assertIn("Critical high", text)
        self.assertNotIn("Problems only", text)

    def shape(self, texts):
        return {name: sorted(text) if isinstance(text, dict) else ""
                for name, text in texts.items()}
