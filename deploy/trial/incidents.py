# Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

"""Incidents that befall the trial's fleet, in minutes, and the alerts that they should raise."""

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
    """Temperatures rise towards their limits for some time, until the cooling fails."""

    rise = 75

    def _changed(self, nodes, minute):
        part = (minute - self.begin) / self.rise
        for node in nodes:
            limits = [node[each] for each in ("upperNonCritical", "upperCritical") if each in node]
            if node["type"] == "temperature" and limits:
                rise = part * (0.98 * min(limits) - node["reading"])
                node["reading"] = round(
                    node["reading"] + rise if part < 1 else 1.1 * max(limits), 2
                )
        return nodes


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
    heat = frozenset({"TemperatureCritical", "HeadroomGone"})
    return [
        StoppedFan((with_fan,), 15, 55, frozenset({"FanStopped"})),
        HeatWave(tuple(racks[1]), 5, 102, heat),
        LostSensor((racks[2][0],), 20, 55, frozenset({"SensorLost"})),
        LostChip((racks[3][0],), 25, 55, frozenset({"ChipGone"})),
        SwitchedOff((racks[4][0],), 20, 55, frozenset({"MachineGone"})),
    ]
