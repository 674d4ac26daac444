# Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

"""Keyboard and screen readers."""

from selenium.webdriver.common.keys import Keys

from browser import PageTest, npm_file
from served import demonstration

CHART = "?device=Battery:/system/board/vbat&device=12 V:/system/board/12v"


class AccessibilityTest(PageTest):
    def setUp(self):
        super().setUp()
        self.server = demonstration()

    def violations(self):
        if not self.run_script("'axe' in window"):
            self.driver.execute_script(npm_file(self, "axe-core/axe.min.js").read_text())
        found = self.driver.execute_async_script(
            "axe.run({resultTypes: ['violations']}).then(arguments[0])")["violations"]
        return [(each["id"], node["html"][:120], node["failureSummary"])
                for each in found for node in each["nodes"]]

    def test_has_no_violation(self):
        self.open(self.server, CHART)
        self.wait_for("document.querySelector('#plot canvas')")
        self.assertEqual([], self.violations())
        self.look(375, scheme="dark")  # where the chart covers the page
        self.assertEqual([], self.violations())
        self.driver.find_element("id", "chart-close").click()
        self.assertEqual([], self.violations())

    def test_has_no_violation_without_scripts(self):
        # axe needs scripts, so those of the page are missing instead.
        self.driver.execute_cdp_cmd("Network.setBlockedURLs", {"urls": ["*/web/Main.js"]})
        self.addCleanup(self.driver.execute_cdp_cmd, "Network.setBlockedURLs", {"urls": []})
        self.expected_errors = ("ERR_BLOCKED_BY_CLIENT",)
        self.driver.get(self.server.address)
        self.assertFalse(self.driver.find_element("id", "table").is_displayed())
        self.run_script("document.getAnimations().forEach(each => each.finish())")
        self.assertTrue(self.driver.find_element("id", "table").is_displayed())
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
        self.wait_for(f"{labels} !== arguments[0]", 10, whole)
        self.press(Keys.ESCAPE)
        self.assertTrue(self.run_script("document.querySelector('#chart').hidden"))
        self.assertTrue(self.run_script("document.activeElement.matches('#troubles button')"))

    def test_names_limits_and_moves_nothing_where_the_user_wants_that(self):
        self.open(self.server)
        self.assertEqual("Low warning 2.7\u00a0V, Low critical 2.5\u00a0V, "
                         "High warning 3.6\u00a0V, High critical 3.8\u00a0V",
                         self.run_script("[...document.querySelectorAll('.chips .sensor')].find("
                                         "row => row.textContent.includes('Battery'))"
                                         ".querySelector('.gauge').ariaLabel"))
        for motion, duration in (("reduce", "0s"), ("no-preference", "0.6s")):
            self.look(motion=motion)
            self.assertEqual(duration, self.run_script(
                "getComputedStyle(document.querySelector('.sensor')).transitionDuration"))
