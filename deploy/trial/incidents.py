# Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

"""Incidents in the trial's fleet, in minutes, and the alerts that they should raise."""

from dataclasses import dataclass

from trial.machine import Machine

# After this many minutes, the incidents begin again.
CYCLE = 180


@dataclass(frozen=True)
class Incident:
    """What happens to machines from one minute to another."""

    machines: tuple[Machine, ...]
    begin: float
    end: float
    alerts: frozenset[str]

    def is_on(self, minute):
        return self.begin <= minute % CYCLE < self.end

    def change(self, machine, nodes, minute):
        """Returns the nodes as they are at that minute, if the machine is concerned."""
        if machine in self.machines and self.is_on(minute):
            return self._changed(nodes, minute % CYCLE)
        return nodes

    def _changed(self, nodes, minute):
        raise NotImplementedError


class HeatWave(Incident):
    """Temperatures rise to the warning limit, slower to the critical one, and beyond both."""

    # In minutes since the begin.
    until_warning = 50
    until_critical = 85

    def _changed(self, nodes, minute):
        for node in nodes:
            limits = [node[each] for each in ("upperNonCritical", "upperCritical") if each in node]
            if node["type"] == "temperature" and limits:
                reading = self._reading(node["reading"], limits, minute - self.begin)
                node["reading"] = round(reading, 2)
        return nodes

    def _reading(self, healthy, limits, minute):
        # A chip may have its critical limit below the warning limit.
        first, last = 0.98 * min(limits), 0.98 * limits[-1]
        if minute < self.until_warning:
            return healthy + (first - healthy) * minute / self.until_warning
        if minute < self.until_critical:
            part = (minute - self.until_warning) / (self.until_critical - self.until_warning)
            return first + (last - first) * part
        return 1.1 * max(limits)


class StoppedFan(Incident):
    """The first fan with a lower limit stands still."""

    def _changed(self, nodes, _):
        fan = next(each for each in nodes if is_watched_fan(each))
        fan["reading"] = 0
        return nodes


def is_watched_fan(node):
    return node["type"] == "tachometer" and "lowerNonCritical" in node


class LostSensor(Incident):
    """The first temperature cannot be read."""

    def _changed(self, nodes, _):
        del next(each for each in nodes if each["type"] == "temperature")["reading"]
        return nodes


class LostChip(Incident):
    """The chip of the last sensor disappears."""

    def _changed(self, nodes, _):
        chip = chip_of(nodes[-1])
        return [each for each in nodes if chip_of(each) != chip]


def chip_of(node):
    return node["path"].rpartition("/")[0]


class SwitchedOff(Incident):
    """The machine does not answer: the fleet ends its server."""

    def _changed(self, nodes, _):
        return nodes


def incidents_of(racks):
    """Returns what happens to a fleet with these lists of machines, an incident for each rack."""
    with_fan = next(each for each in racks[0] if any(is_watched_fan(node) for node in each.nodes))
    heat = frozenset({"TemperatureWarning", "HeadroomGone", "TemperatureCritical"})
    return [
        StoppedFan((with_fan,), 15, 80, frozenset({"FanStopped"})),
        HeatWave(tuple(racks[1]), 5, 108, heat),
        LostSensor((racks[2][0],), 20, 80, frozenset({"SensorLost"})),
        LostChip((racks[3][0],), 15, 80, frozenset({"ChipGone"})),
        SwitchedOff((racks[4][0],), 20, 80, frozenset({"MachineGone"})),
    ]
