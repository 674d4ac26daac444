# Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

"""Keyboard and screen readers."""

from selenium.webdriver.common.keys import Keys

from browser import PageTest, npm_file
from machine import Machine
from served import wave


class AccessibilityTest(PageTest):
    def setUp(self):
        super().setUp()
        self.server = self.serve(Machine.demonstration(), past=wave)

    def violations(self):
        self.driver.execute_script(npm_file(self, "axe-core/axe.min.js").read_text())
        found = self.driver.execute_async_script("axe.run().then(arguments[0])")["violations"]
        return [(each["id"], node["html"][:120], node["failureSummary"])
                for each in found for node in each["nodes"]]

    def test_has_no_violation(self):
        chart = "?device=Battery:/system/board/vbat&device=12 V:/system/board/12v"
        for scheme, width in (("light", 1280), ("dark", 375)):
            with self.subTest(scheme=scheme, width=width):
                self.look(width, 900, scheme)
                self.open(self.server)
                self.assertEqual([], self.violations())
                self.open(self.server, chart)
                self.wait_for("document.querySelector('#plot canvas')")
                self.assertEqual([], self.violations())

    def test_has_no_violation_without_scripts(self):
        # axe needs scripts, so those of the page are missing instead.
        self.driver.execute_cdp_cmd("Network.setBlockedURLs", {"urls": ["*/web/Main.js"]})
        self.addCleanup(self.driver.execute_cdp_cmd, "Network.setBlockedURLs", {"urls": []})
        self.expected_errors = ("ERR_BLOCKED_BY_CLIENT",)
        self.driver.get(self.server.address)
        self.assertFalse(self.driver.find_element("id", "table").is_displayed())
        self.wait_for("document.querySelector('#table').checkVisibility()", 5)
        self.assertEqual([], self.violations())

    def test_works_by_keyboard_alone(self):
        self.open(self.server)
        self.press(Keys.TAB)
        self.assertEqual("Skip to the sensors", self.focused())
        self.press(Keys.ENTER, Keys.TAB)
        self.assertEqual("CPU 2 DIMM D1 Temp", self.focused())
        self.press(Keys.ENTER)
        self.wait_for("document.querySelector('#plot canvas')")
        self.assertEqual("CPU 2 DIMM D1 Temp", self.focused())
        self.press(Keys.TAB, Keys.TAB, Keys.ENTER)
        self.wait_for("document.querySelector('[data-span=day]').ariaPressed === 'true'")
        self.press(Keys.TAB, Keys.TAB)
        self.assertEqual("Zoom in", self.focused())
        labels = ("[...document.querySelectorAll('#plot .dygraph-axis-label-x')]"
                  ".map(each => each.textContent).join()")
        whole = self.run_script(labels)
        self.press(Keys.ENTER)
        self.wait_for(f"{labels} !== arguments[0]", 3, whole)
        self.press(Keys.ESCAPE)
        self.assertTrue(self.run_script("document.querySelector('#chart').hidden"))
        self.assertTrue(self.run_script("document.activeElement.matches('#troubles button')"))

    def test_keeps_the_focus_when_a_trouble_ends(self):
        self.open(self.server)
        self.driver.execute_script("document.querySelector('#troubles button').focus()")
        self.server.machine.set_reading("/system/cpu2/dimmd1", 50)
        self.wait_for("!document.querySelector('#troubles').textContent.includes('D1')", 3)
        self.assertEqual("CPU 2 DIMM D1 Temp", self.focused())

    def test_names_limits_and_states(self):
        self.open(self.server)
        self.assertEqual("Low warning 2.7\u00a0V, Low critical 2.5\u00a0V, "
                         "High warning 3.6\u00a0V, High critical 3.8\u00a0V",
                         self.run_script("[...document.querySelectorAll('.chips .sensor')].find("
                                         "row => row.textContent.includes('Battery'))"
                                         ".querySelector('.gauge').ariaLabel"))

    def test_moves_nothing_where_the_user_wants_that(self):
        self.driver.execute_cdp_cmd("Emulation.setEmulatedMedia", {
            "features": [{"name": "prefers-reduced-motion", "value": "reduce"}]})
        self.open(self.server)
        self.assertIn("0s", self.run_script(
            "getComputedStyle(document.querySelector('.sensor')).transitionDuration"))
