# Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

"""Debian's Chromium, with what the tests ask of it."""

import atexit
import base64
import functools
import json
import os
import pathlib
import tempfile
import time
import unittest

from selenium import webdriver
from selenium.webdriver.chrome.service import Service

from served import Server

# Where screenshots are kept, and packages of npm are.
FOLDER = pathlib.Path(os.environ.get("SENSOR_PROFILE_WEB_FOLDER", tempfile.gettempdir()))
FLAGS = ("--headless", "--no-sandbox", "--disable-gpu", "--disable-quic", "--no-first-run",
         "--disable-background-networking", "--disable-component-update", "--disable-sync",
         "--hide-scrollbars")


@functools.cache
def chromium():
    """Returns the driver of the one browser of a test run."""
    profile = tempfile.TemporaryDirectory()  # pylint: disable=consider-using-with
    options = webdriver.ChromeOptions()
    options.binary_location = "/usr/bin/chromium"
    for flag in (*FLAGS, f"--user-data-dir={profile.name}"):
        options.add_argument(flag)
    options.set_capability("goog:loggingPrefs", {"browser": "ALL"})
    driver = webdriver.Chrome(service=Service("/usr/bin/chromedriver"), options=options)
    atexit.register(profile.cleanup)
    atexit.register(driver.quit)
    return driver


class PageTest(unittest.TestCase):
    """A page of a served machine. Fails when the console of the browser has an error."""

    def setUp(self):
        self.driver = chromium()
        self.expected_errors = ()
        self.look()

    def tearDown(self):
        errors = [entry["message"] for entry in self.driver.get_log("browser")
                  if entry["level"] == "SEVERE"]
        self.driver.get("about:blank")
        self.assertEqual([], [error for error in errors if not any(
            expected in error for expected in self.expected_errors)])

    def serve(self, machine, **options):
        """Serves a machine until the end of the test."""
        server = Server(machine, **options).start()
        self.addCleanup(server.stop)
        return server

    def look(self, width=1280, height=900, scheme="light", language="en", has_scripts=True,
             motion="reduce"):
        """Sets how the page and the following ones are looked at."""
        command = self.driver.execute_cdp_cmd
        command("Network.enable", {})
        command("Emulation.setDeviceMetricsOverride", {
            "width": width, "height": height, "deviceScaleFactor": 1, "mobile": width < 600})
        command("Emulation.setEmulatedMedia", {"features": [
            {"name": "prefers-color-scheme", "value": scheme},
            {"name": "prefers-reduced-motion", "value": motion}]})
        command("Network.setExtraHTTPHeaders", {"headers": {"Accept-Language": language}})
        command("Emulation.setScriptExecutionDisabled", {"value": not has_scripts})

    def open(self, server, query=""):
        """Opens the page and waits until it is live."""
        self.driver.get(server.address + query)
        self.wait_for("document.querySelector('.chips .sensor')")

    def run_script(self, script, *arguments):
        """Returns what an expression of JavaScript is worth."""
        return self.driver.execute_script(f"return {script}", *arguments)

    def wait_for(self, condition, seconds=10, *arguments):
        """Waits until an expression is true, and returns its value."""
        end = time.monotonic() + seconds
        while not (value := self.run_script(condition, *arguments)):
            self.assertLess(time.monotonic(), end, f"not within {seconds} s: {condition}")
            time.sleep(0.05)
        return value

    def row_text(self, label):
        """Returns the text of a sensor's row among the chips; None for no row."""
        return self.run_script(
            "[...document.querySelectorAll('.chips .sensor')]"
            ".find(row => row.querySelector('button').textContent === arguments[0])?.innerText",
            label)

    def search(self, text):
        """Searches, and returns the number of sensors that are found."""
        return self.driver.execute_script(
            "const field = document.querySelector('[name=search]'); field.value = arguments[0];"
            "field.dispatchEvent(new Event('input', {bubbles: true}));"
            "return document.querySelectorAll('.chips .sensor:not([hidden])').length", text)

    def press(self, *keys):
        """Presses keys, wherever the focus is."""
        webdriver.ActionChains(self.driver).send_keys(*keys).perform()

    def focused(self):
        """Returns the text of the focused element, or what it is called."""
        return self.run_script("document.activeElement.ariaLabel || "
                               "document.activeElement.textContent.trim() || "
                               "document.activeElement.name")

    def keep_screenshot(self, name):
        """Keeps what the window shows as a file of the test run."""
        folder = FOLDER / "screenshots"
        folder.mkdir(parents=True, exist_ok=True)
        (folder / f"{name}.png").write_bytes(self.driver.get_screenshot_as_png())

    def print_to(self, name):
        """Prints the page to a file and returns the file."""
        folder = FOLDER / "screenshots"
        folder.mkdir(parents=True, exist_ok=True)
        printed = self.driver.execute_cdp_cmd("Page.printToPDF", {"printBackground": False})
        file = folder / f"{name}.pdf"
        file.write_bytes(base64.b64decode(printed["data"]))
        return file


def cannot_run(test, reason):
    """Skips a test that cannot run here; fails it in CI, which runs all tests."""
    if os.environ.get("CI"):
        test.fail(f"{reason}; CI must not skip")
    print(f"\nSKIPPED: {reason}")
    test.skipTest(reason)


def npm_file(test, name):
    """Returns a file of a package of npm that the test's setup has installed."""
    file = FOLDER / "node_modules" / name
    if not file.exists():
        cannot_run(test, f"npm could not install {name.split('/')[0]}")
    return file


def dictionary(language):
    """Returns the page's texts in a language."""
    from machine import ROOT
    return json.loads((ROOT / f"web/languages/{language}.json").read_text())
