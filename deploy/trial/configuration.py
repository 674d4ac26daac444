# Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

"""The configuration of the trial, which is that of `deploy/` with other addresses and times.

Every duration of the rules and of the routes is divided by the speed of the trial: how long alerts
are pending and keep firing, the ranges, steps and offsets in expressions, the horizon of
predictions, and the waits of Alertmanager.
"""

import pathlib
import re
import subprocess

import yaml

from trial import credentials

DEPLOY = pathlib.Path(__file__).resolve().parent.parent
SECONDS = {"s": 1, "m": 60, "h": 3600, "d": 86400}
DURATION = r"(\d+)([smhd])"


def shorten(duration, speed):
    """Returns a duration such as `15m` divided by the speed."""
    number, unit = re.fullmatch(DURATION, duration).groups()
    return f"{max(1, round(int(number) * SECONDS[unit] * 1000 / speed))}ms"


def shorten_expression(expression, speed):
    """Divides the durations of an expression of PromQL by the speed."""

    def shortened(match):
        return match[1] + shorten(match[2] + match[3], speed)

    expression = re.sub(r"(\[|:|offset )" + DURATION, shortened, expression)
    return re.sub(
        r"(predict_linear\([^,]*, )(\d+)\)",
        lambda match: f"{match[1]}{int(match[2]) / speed})",
        expression,
    )


def rules(file, speed):
    """Returns the rules of a file of `prometheus/rules`."""
    content = read(f"prometheus/rules/{file}")
    for group in content["groups"]:
        # All groups have the interval of the trial.
        group.pop("interval", None)
        for rule in group["rules"]:
            rule["expr"] = shorten_expression(rule["expr"], speed)
            for key in ("for", "keep_firing_for"):
                if key in rule:
                    rule[key] = shorten(rule[key], speed)
    return content


def prometheus(ports, interval, rule_interval):
    """Returns the configuration of Prometheus, with the machines of the folder `targets`."""
    content = read("prometheus/prometheus.yml") | read("victoria-metrics/remote-write.yml")
    content["global"]["scrape_interval"] = f"{interval}s"
    content["global"]["scrape_timeout"] = f"{min(interval, 10)}s"
    content["global"]["evaluation_interval"] = f"{rule_interval}s"
    content["alerting"]["alertmanagers"] = [
        {"static_configs": [{"targets": [f"127.0.0.1:{ports.alertmanager}"]}]}
    ]
    content["remote_write"][0]["url"] = f"http://127.0.0.1:{ports.victoria_metrics}/api/v1/write"
    job = next(each for each in content["scrape_configs"] if each["job_name"] == "sensor-profile")
    # The machines are loopback addresses with one certificate; nothing answers names here.
    del job["dns_sd_configs"]
    job["tls_config"]["server_name"] = credentials.HOST
    content["scrape_configs"] = [job]
    return content


def alertmanager(ports, speed):
    """Returns the configuration of Alertmanager, with its receivers replaced by the trial's."""
    content = read("prometheus/alertmanager.yml")
    del content["global"]
    routes = [content["route"]]
    for route in routes:
        routes += route.get("routes", [])
        for wait in ("group_wait", "group_interval", "repeat_interval"):
            if wait in route:
                route[wait] = shorten(route[wait], speed)
    content["receivers"] = [
        {
            "name": receiver["name"],
            "webhook_configs": [{"url": f"http://127.0.0.1:{ports.receiver}/{receiver['name']}"}],
        }
        for receiver in content["receivers"]
    ]
    return content


def victoria_metrics(folder, ports, interval):
    """Returns the options of VictoriaMetrics."""
    file = DEPLOY / "victoria-metrics/victoria-metrics.default"
    command = ("sh", "-c", '. "$1"; printf "%s\\n" $ARGS', "sh", file)
    words = subprocess.run(command, check=True, capture_output=True, text=True).stdout.split()
    options = dict(each.split("=", 1) for each in words)
    options["-storageDataPath"] = folder / "victoria-metrics"
    options["-httpListenAddr"] = f"127.0.0.1:{ports.victoria_metrics}"
    options["-dedup.minScrapeInterval"] = f"{interval}s"
    return [f"{name}={value}" for name, value in options.items()]


def targets(racks, port):
    """Returns the machines of the racks, for the discovery by files."""
    return [
        {
            "labels": {"site": rack[0].site, "rack": rack[0].rack},
            "targets": [f"{machine.address}:{port}" for machine in rack],
        }
        for rack in racks
    ]


def write_all(folder, options, ports, racks):
    """Writes the files of Prometheus and Alertmanager into the folder."""
    for file in ("recording.yml", "alerts.yml"):
        write(folder / "rules" / file, rules(file, options.speed))
    write(folder / "targets/fleet.yml", targets(racks, ports.machine))
    write(
        folder / "prometheus.yml", prometheus(ports, options.interval, options.rule_interval)
    )
    write(folder / "alertmanager.yml", alertmanager(ports, options.speed))


def read(file):
    return yaml.safe_load((DEPLOY / file).read_text(encoding="utf-8"))


def write(file, content):
    file.parent.mkdir(exist_ok=True)
    file.write_text(yaml.safe_dump(content, allow_unicode=True), encoding="utf-8")
