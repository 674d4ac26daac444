# Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

"""Names of sensors and chips are data, never markup."""

from browser import PageTest
from machine import Machine
from served import Server

MARKUP = "<img src=x onerror=alert(1)><script>document.title='broken'</script>"
TURNED = "\u202eTurned\u2066 \u200fleft\u2069\u202e"
MARKS = "\u200f\u202e\u2066\u2069"
QUOTED = "\"'&amp;{{machine}}${1}"


def node(path, label):
    return {"type": "temperature", "path": path, "description": label, "status": 23,
            "baseUnits": 2, "reading": 91, "upperNonCritical": 86, "possibleStates": [1, 23]}


class SafetyTest(PageTest):
    @classmethod
    def setUpClass(cls):
        cls.labels = (MARKUP, TURNED, QUOTED)
        cls.server = Server(Machine([node("/a<b>/" + str(index), label)
                                     for index, label in enumerate(cls.labels)])).start()
        cls.addClassCleanup(cls.server.stop)

    def test_shows_markup_as_text(self):
        self.open(self.server)
        for label in self.labels:
            self.assertIsNotNone(self.row_text(label), label)
        self.assertEqual(
            "a<b>", self.run_script("document.querySelector('.chip-title').textContent"))
        self.assertEqual("isolate", self.run_script(
            "getComputedStyle(document.querySelector('.sensor bdi')).unicodeBidi"))
        for row in self.driver.find_elements("css selector", ".chips .sensor"):
            name = row.get_attribute("data-device")
            with self.subTest(name):
                self.driver.execute_script("arguments[0].click()", row)
                self.wait_for("document.querySelector('#plot canvas')")
                self.wait_for("document.querySelector('#plot-summary').textContent"
                              ".includes(arguments[0])", 5,
                              name.rpartition(":")[0].translate(dict.fromkeys(map(ord, MARKS))))
        self.driver.execute_script("document.querySelector('#compare').selectedIndex = 1;"
                                   "document.querySelector('#compare-add').click()")
        self.wait_for("document.querySelectorAll('#compared li').length === 2")
        self.assertEqual(
            0, self.run_script("document.querySelectorAll('img, main script').length"))
        self.assertNotEqual("broken", self.driver.title)

    def test_shows_markup_as_text_without_scripts(self):
        self.look(has_scripts=False)
        self.driver.get(self.server.address)
        self.assertIn(MARKUP, self.driver.find_element("id", "table").text)
        self.assertIn(QUOTED, self.driver.find_element("id", "table").text)

    def test_is_refused_what_the_policy_forbids(self):
        self.expected_errors = ("Content Security Policy",)
        self.open(self.server)
        self.driver.execute_script(
            "const script = document.createElement('script');"
            "script.textContent = 'window.ran = true'; document.body.append(script);"
            "const span = document.createElement('span');"
            "span.setAttribute('style', 'color: red'); document.body.append(span);")
        self.assertIsNone(self.run_script("window.ran"))
