# Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

"""What the page of a machine with 1,000 sensors has the browser do."""

from browser import PageTest
from machine import Machine

SENSORS = 1000
CHANGED = 200
ROWS = "[...document.querySelectorAll('.chips .sensor')]"

# Collects the elements that change, but for sparklines, which are drawn every ten seconds.
OBSERVE = """
    window.changed = [];
    new MutationObserver((records) => window.changed.push(...records.map(({target}) => target)
        .filter((target) => !target.closest('.sparkline')))).observe(document.body,
        {subtree: true, childList: true, attributes: true});"""
REQUESTS = "performance.getEntriesByType('resource').map(each => new URL(each.name).pathname)"


class LargeMachineTest(PageTest):
    def test_changes_only_the_rows_of_changed_sensors(self):
        machine = Machine.of_size(SENSORS)
        self.open(self.serve(machine))
        self.wait_for(f"{REQUESTS}.includes('/api/history')")
        requests = self.run_script(REQUESTS)
        self.assertEqual(len(set(requests)), len(requests))
        self.assertEqual(SENSORS, self.run_script(f"{ROWS}.length"))
        self.assertEqual(10, self.search("board 99"))
        self.assertEqual(SENSORS, self.search(""))

        self.driver.execute_script(OBSERVE)
        changed = machine.change_temperatures(CHANGED, 48)
        self.wait_for(
            f"{ROWS}.filter(row => row.textContent.includes('48.0')).length === {CHANGED}")
        rows = self.run_script("[...new Set(window.changed.map(each => each.closest('.sensor')))]"
                               ".map(row => row?.dataset.device)")
        self.assertEqual(sorted(changed), sorted(rows))
        # The reading and the place of the gauge's marker.
        self.assertEqual(2 * CHANGED, self.run_script("window.changed.length"))
        self.assertEqual(requests, self.run_script(REQUESTS))
