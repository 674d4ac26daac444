# Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

"""What the page shows while the machine changes."""

import time

from browser import PageTest
from machine import Machine

FAN = "/system/fan1"
TROUBLES = ("[...document.querySelectorAll('#troubles .sensor button')]"
            ".map(each => each.textContent)")
TITLES = "[...document.querySelectorAll('.chip-title')].map(each => each.textContent)"


def past(node, age):
    """Returns the reading of a node some seconds ago: one became a trouble ten minutes ago."""
    return 50 if age > 600 and node["path"] == "/system/cpu2/package" else node.get("reading")


class LiveTest(PageTest):
    def setUp(self):
        super().setUp()
        self.machine = Machine.demonstration()
        self.server = self.serve(self.machine, past=past)
        self.open(self.server)

    def trouble_text(self, label):
        return self.wait_for("[...document.querySelectorAll('#troubles .sensor')].find("
                             "row => row.textContent.includes(arguments[0]) && "
                             "row.querySelector('.since').textContent)?.innerText", 10, label)

    def seconds_until(self, condition):
        begin = time.monotonic()
        self.wait_for(condition)
        return time.monotonic() - begin

    def lost(self, number):
        return ("document.querySelector('#counts [data-urgency=lost]')"
                f".dataset.number === '{number}'")

    def test_shows_changes_within_three_seconds(self):
        self.assertEqual(
            ["CPU 2 DIMM D1 Temp", "PSU 2 Fan", "PSU 2 Input", "System Fan 4", "Battery",
             "CPU 2 Package Temp", "NVMe 2 Temp"], self.run_script(TROUBLES))
        self.assertRegex(self.trouble_text("CPU 2 Package Temp"), r"Warning high since \d")
        self.assertRegex(self.trouble_text("Battery"), r"Warning low since before \d")
        self.driver.execute_script("document.querySelector('#troubles button').focus()")

        # Together: two sensors cross limits, one recovers, one is lost, a chip vanishes, one is new.
        with self.machine.changes():
            self.machine.set_reading(FAN, 450)
            self.machine.set_reading("/system/cpu2/package", 97)
            self.machine.set_reading("/system/cpu2/dimmd1", 50)
            self.machine.lose("/system/nic1/asic")
            removed = self.machine.remove_chip("/system/psu1")
            self.machine.add([{"type": "temperature", "path": "/system/cpu10/t", "baseUnits": 2,
                               "description": "CPU 10", "status": 1, "reading": 40}])
        seconds = [self.seconds_until(f"{TROUBLES}.includes('System Fan 1')")]
        self.assertIn("450\u00a0RPM", self.row_text("System Fan 1"))
        self.assertIn("Critical low", self.row_text("System Fan 1"))
        self.assertEqual(
            ["System Fan 1", "CPU 2 Package Temp", "PSU 2 Fan", "PSU 2 Input", "System Fan 4",
             "Battery", "NIC 1 Temp", "NVMe 2 Temp", "PSU 1 Fan", "PSU 1 Input", "PSU 1 Temp"],
            self.run_script(TROUBLES))
        self.assertRegex(self.driver.title, r"^\(11\) ")
        self.assertEqual("CPU 2 DIMM D1 Temp", self.focused())
        self.assertTrue(self.run_script(self.lost(5)))
        self.assertRegex(self.row_text("PSU 1 Fan"), r"(?s)–.*Gone")
        self.assertRegex(self.trouble_text("PSU 1 Fan"), r"Gone since \d")
        self.assertRegex(self.trouble_text("NIC 1 Temp"), r"Lost since \d")
        titles = self.run_script(TITLES)
        place = titles.index("system/cpu10")
        self.assertEqual(["system/cpu2", "system/nic1"], [titles[place - 1], titles[place + 1]])
        self.wait_for("document.querySelector('#announcement').textContent"
                      ".includes('Critical low')")

        with self.machine.changes():
            self.machine.set_reading(FAN, 5300)
            self.machine.add(removed)
        seconds.append(self.seconds_until(f"!{TROUBLES}.includes('System Fan 1')"))
        self.assertLess(min(seconds), 3)  # the machine may be busy during one of them
        self.assertTrue(self.run_script(self.lost(2)))
        self.assertIn("7936\u00a0RPM", self.row_text("PSU 1 Fan"))

    def test_shows_a_change_among_those_found_and_in_the_chart(self):
        found = "document.querySelector('#found').innerText"
        self.open(self.server,
                  "?problems=1&search=kind:fan&device=System Fan 5:/system/fan5")
        self.wait_for("document.querySelector('#plot canvas')")
        self.assertEqual("Shown: 2", self.run_script(found))
        self.machine.set_reading("/system/fan5", 100)
        self.wait_for(f"{found} === 'Shown: 3'")
        self.assertTrue(self.row_text("System Fan 5"))
        self.assertEqual("100\u00a0RPM", self.run_script(
            "document.querySelector('#compared .value').textContent"))

    def test_does_not_take_the_begin_of_the_history_for_that_of_a_state(self):
        script = """
            const [states, done] = arguments;
            const document = {interval: 10, end: 1000,
                sensors: [{deviceId: 'a', values: [], states}]};
            window.fetch = async () => new Response(JSON.stringify(document));
            import('/web/HourHistory.js').then(({HourHistory}) =>
                new HourHistory({setSince: ([first]) => done(first)}).load());"""
        for states, is_earlier in (
                ([], True), ([["Lost", 3]], True), ([[None, 5], ["Lost", 3]], True),
                ([["Normal", 5], ["Lost", 3]], False)):
            with self.subTest(states):
                result = self.driver.execute_async_script(script, states)
                self.assertEqual(is_earlier, result["isSinceEarlier"])
                self.assertEqual(970 if states else 1000, result["since"])

    def test_names_a_source_that_cannot_be_read(self):
        words = "document.querySelector('#lost-sources').textContent"
        sentence = f"Not all sensors of \u2068model:{self.server.model}\u2069 can be read."
        self.assertEqual("", self.run_script(words))
        self.server.model.write_text("{broken")
        self.wait_for(f"{words} === arguments[0]", 10, sentence)
        self.driver.refresh()
        self.wait_for("!document.querySelector('#overview').hidden")
        self.assertEqual(sentence, self.run_script(words))
        self.machine.on_change()
        self.wait_for(f"{words} === ''")

    def test_remembers_for_a_day_what_is_gone(self):
        counts = self.driver.execute_async_script(
            "const done = arguments[0];"
            "import('/web/Machine.js').then(({Machine}) => {"
            "    const machine = new Machine();"
            "    machine.setTime(1000000);"
            "    machine.replace([{deviceId: 'a:/b/a', chip: 'b', label: 'a', state: 'Lost'}]);"
            "    machine.apply({time: 1000000, sensors: [], gone: ['a:/b/a']});"
            "    done([23, 25].map((hours) => {"
            "        machine.setTime(1000000 + 3600 * hours);"
            "        return machine.troubles().length;"
            "    }));"
            "});")
        self.assertEqual([1, 0], counts)

    def test_has_no_readings_of_the_time_without_a_connection(self):
        values = self.driver.execute_async_script(
            "const done = arguments[0];"
            "let tick;"
            "window.setInterval = (callback) => { tick = callback; };"
            "window.fetch = async () => new Response(JSON.stringify({interval: 60, end: 1000,"
            "    sensors: [{deviceId: 'a', values: [1, 2], states: []}]}));"
            "import('/web/HourHistory.js').then(async ({HourHistory}) => {"
            "    const sensors = new Map([['a', {deviceId: 'a', value: 42}]]);"
            "    const history = new HourHistory({sensors, setSince() {}});"
            "    await history.load();"
            "    for (history.isLive of [true, false])"
            "        tick();"
            "    done(history.valuesOf('a'));"
            "});")
        self.assertEqual([1, 2, 42, None, None], values)

    def test_tells_the_last_event_as_the_begin_of_a_lost_connection(self):
        states = self.driver.execute_async_script(
            "const done = arguments[0];"
            "let source;"
            "window.EventSource = class extends EventTarget {"
            "    constructor() { super(); source = this; }"
            "    close() {}"
            "};"
            "import('/web/EventStream.js').then(({EventStream}) => {"
            "    const states = [];"
            "    new EventStream(() => {}, (...state) => states.push(state));"
            "    Date.now = () => 1000;"
            "    source.dispatchEvent(new MessageEvent('alive', {data: '{}'}));"
            "    Date.now = () => 31000;"
            "    source.dispatchEvent(new Event('error'));"
            "    done(states);"
            "});")
        self.assertEqual([["connecting", None], ["live", 1000], ["lost", 1000]], states)

    def test_survives_a_restart_of_the_server(self):
        self.expected_errors = ("ERR_CONNECTION_REFUSED", "ERR_INCOMPLETE_CHUNKED_ENCODING",
                                "ERR_CONNECTION_RESET", "ERR_EMPTY_RESPONSE")
        self.server.stop()
        self.wait_for("/^Connection lost since \\d/.test("
                      "document.querySelector('#connection').textContent)")
        self.machine.set_reading(FAN, 600)
        removed = self.machine.remove_chip("/system/nic1")
        self.server.start()
        self.wait_for("document.querySelector('#connection').textContent === 'Live'")
        self.assertIn("Warning low", self.row_text("System Fan 1"))
        self.assertIn("Gone", self.row_text(removed[0]["description"]))
        self.assertIn("since before", self.run_script(
            "document.querySelector('#troubles').textContent"))

    def test_closes_the_connection_while_the_page_is_hidden(self):
        page = self.driver.current_window_handle
        self.driver.switch_to.new_window("tab")
        end = time.monotonic() + 3
        while self.server.event_streams > 0 and time.monotonic() < end:
            time.sleep(0.05)
        hidden = self.server.event_streams
        self.driver.close()
        self.machine.set_reading(FAN, 450)
        self.driver.switch_to.window(page)
        self.assertEqual(0, hidden)
        self.wait_for(f"{TROUBLES}.includes('System Fan 1')")
