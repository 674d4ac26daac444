# Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

"""The chart: its spans, zoom and comparison."""

from selenium.webdriver import ActionChains
from selenium.webdriver.support.ui import Select

from browser import PageTest
from machine import Machine
from served import demonstration

CPU1 = "CPU 1 Package Temp:/system/cpu1/package"
CPU2 = "CPU 2 Package Temp:/system/cpu2/package"
LEGEND = ("[...document.querySelectorAll('#compared bdi:not(.chip-name)')]"
          ".map(each => each.textContent)")
AXIS = ("[...document.querySelectorAll('#plot .dygraph-axis-label-x')]"
        ".map(each => each.textContent).filter(text => text)")

# Whether the chart has a point of the color of that name.
DRAWS = """(() => {
    const probe = document.createElement('span');
    probe.style.color = `var(${arguments[0]})`;
    document.body.append(probe);
    const wanted = getComputedStyle(probe).color.match(/\\d+/g).map(Number);
    probe.remove();
    return [...document.querySelectorAll('#plot canvas')].some((canvas) => {
        const {data} = canvas.getContext('2d').getImageData(0, 0, canvas.width, canvas.height);
        for (let i = 0; i < data.length; i += 4)
            if (data[i + 3] === 255 && wanted.every((part, j) => data[i + j] === part))
                return true;
        return false;
    });
})()"""


class ChartTest(PageTest):
    def setUp(self):
        super().setUp()
        self.server = demonstration()

    def open_chart(self, query, server=None):
        self.open(server or self.server, query)
        self.wait_for("document.querySelector('#plot canvas') && "
                      "document.querySelector('#plot-summary').textContent")

    def test_opens_by_a_click_and_closes_by_its_button(self):
        self.open(self.server)
        self.driver.find_element("css selector", ".chips .sensor .gauge").click()
        self.wait_for("document.querySelector('#plot canvas')")
        self.assertEqual(["System Fan 1"], self.run_script(LEGEND))
        self.assertIn("device=System+Fan+1", self.driver.current_url)
        self.assertEqual("true", self.run_script(
            "document.querySelector('.chips .sensor button').ariaExpanded"))
        self.driver.find_element("id", "chart-close").click()
        self.assertTrue(self.run_script("document.querySelector('#chart').hidden"))
        self.assertNotIn("device", self.driver.current_url)
        self.look(width=1000)
        self.driver.back()
        self.wait_for("document.querySelector('#plot canvas')?.clientWidth > 900")

    def test_compares_sensors_of_one_unit(self):
        self.open_chart("?device=" + CPU2)
        select = Select(self.driver.find_element("id", "compare"))
        self.assertEqual([], [option.text for option in select.options if "Fan" in option.text])
        select.select_by_value(CPU1)
        self.assertEqual(["CPU 2 Package Temp"], self.run_script(LEGEND))
        self.driver.find_element("id", "compare-add").click()
        self.wait_for(f"{LEGEND}.length === 2")
        self.wait_for("document.querySelector('#plot-summary').textContent.includes('CPU 1')")
        self.driver.back()
        self.wait_for(f"{LEGEND}.length === 1")
        self.driver.forward()
        self.wait_for(f"{LEGEND}.length === 2")
        self.driver.find_element("css selector", "#compared li:first-child button").click()
        self.assertEqual(["CPU 1 Package Temp"], self.run_script(LEGEND))
        self.assertEqual("CPU 1 Package Temp", self.focused())

    def test_zooms_by_the_pointer_and_back_by_the_button(self):
        self.open_chart("?device=" + CPU2)
        whole = ",".join(self.run_script(AXIS))
        plot = self.driver.find_element("id", "plot")
        ActionChains(self.driver, duration=50).move_to_element(plot).click_and_hold(
        ).move_by_offset(150, 0).release().perform()
        self.wait_for(f"{AXIS}.join() !== arguments[0]", 10, whole)
        self.wait_for("/°C \\(.*:.*:/.test("
                      "document.querySelector('#compared .value').textContent)")
        self.driver.find_element("css selector", "[data-zoom=all]").click()
        self.wait_for(f"{AXIS}.join() === arguments[0]", 10, whole)

    def test_shows_the_last_day(self):
        self.open_chart("?device=" + CPU2)
        hour = self.run_script(AXIS)
        self.driver.find_element("css selector", "[data-span=day]").click()
        self.wait_for(f"{AXIS}.join() !== arguments[0]", 10, ",".join(hour))
        self.assertIn("span=day", self.driver.current_url)
        self.assertEqual("true", self.run_script(
            "document.querySelector('[data-span=day]').ariaPressed"))
        self.assertIn("Prometheus", self.driver.find_element("id", "chart").text)

    def test_draws_limits_and_states(self):
        self.open_chart("?device=" + CPU2)
        for scheme in ("light", "dark"):
            self.look(scheme=scheme)
            for name in ("--critical", "--warning-band"):
                with self.subTest(name, scheme=scheme):
                    self.wait_for(DRAWS, 5, name)

    def test_draws_fatal_limits_and_the_shapes_of_states(self):
        self.open(self.server)
        self.driver.execute_script(
            "window.drawn = []; window.shapes = 0; const {prototype} = CanvasRenderingContext2D;"
            "const {fill, fillText} = prototype; prototype.fill = function (...path) {"
            "    shapes += path[0] instanceof Path2D; fill.apply(this, path); }; prototype.fillText = function (words, ...place) {"
            "    drawn.push(words); fillText.call(this, words, ...place); };"
            "[...document.querySelectorAll('.chips .sensor button')].find(button =>"
            "    button.textContent === 'CPU 2 Package Temp').click();")
        self.wait_for("drawn.includes('High fatal 100\u00a0°C')")
        self.assertLess(0, self.run_script("shapes"))

    def test_names_the_sensors_that_are_not_shown(self):
        self.open_chart("?device=none:/a&device=" + CPU2 + "&device=" + CPU2 +
                        "&device=System Fan 5:/system/fan5")
        missing = self.driver.find_element("id", "missing")
        self.assertEqual(
            "The machine has no sensor \u2068none:/a\u2069 now. Not in the chart, which compares "
            "up to 6 sensors of one unit: \u2068System Fan 5\u2069.",
            missing.get_property("textContent"))
        self.assertLess(missing.location["y"],
                        self.driver.find_element("id", "troubles").location["y"])
        self.assertEqual(["CPU 2 Package Temp"], self.run_script(LEGEND))

    def test_lists_the_states_in_words(self):
        self.open_chart("?device=" + CPU2)
        self.driver.find_element("css selector", "#chart summary").click()
        states = self.run_script("[...document.querySelectorAll('#state-changes li')]"
                                 ".map(item => item.innerText)")
        self.assertRegex(states[0], "CPU 2 Package Temp.*: Warning high, ")
        self.assertTrue(any("Normal" in state for state in states), states)

    def test_says_when_there_is_no_history(self):
        self.open(self.serve(Machine.demonstration(), is_history_kept=False),
                  "?device=" + CPU2)
        self.wait_for("document.querySelector('#plot-summary').textContent"
                      " === 'No history is available.'")
