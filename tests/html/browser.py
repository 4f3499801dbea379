"""A headless Chromium without a network."""
import json
import os
import time

from selenium import webdriver
from selenium.webdriver.chrome.options import Options
from selenium.webdriver.chrome.service import Service

ARGUMENTS = ['--headless=new', '--disable-gpu', '--disable-dev-shm-usage', '--hide-scrollbars', '--disable-background-networking',
             '--host-resolver-rules=MAP * ~NOTFOUND', '--force-device-scale-factor=1']
PATIENCE = 120  # seconds until a page that never gets ready is given up


class Browser:
    def __init__(self):
        options = Options()
        options.binary_location = '/usr/bin/chromium'
        # The sandbox of Chromium refuses to run as root.
        for argument in ARGUMENTS + (['--no-sandbox'] if os.geteuid() == 0 else []):
            options.add_argument(argument)
        options.set_capability('goog:loggingPrefs', {'browser': 'ALL', 'performance': 'ALL'})
        self.driver = webdriver.Chrome(service=Service('/usr/bin/chromedriver'), options=options)
        self.driver.set_script_timeout(PATIENCE)
        self.before = None

    def quit(self):
        self.driver.quit()

    def look(self, width=1440, height=1000, dark=False):
        self.driver.execute_cdp_cmd('Emulation.setDeviceMetricsOverride',
                                    {'width': width, 'height': height, 'deviceScaleFactor': 1, 'mobile': False})
        self.driver.execute_cdp_cmd('Emulation.setEmulatedMedia', {'features': [
            {'name': 'prefers-color-scheme', 'value': 'dark' if dark else 'light'},
            {'name': 'prefers-reduced-motion', 'value': 'reduce'}]})

    def run_first(self, script):
        """Runs a script in front of those of the page, until the next `open`."""
        self.before = self.driver.execute_cdp_cmd('Page.addScriptToEvaluateOnNewDocument', {'source': script})['identifier']

    def open(self, path):
        self.requests()
        self.messages()
        self.driver.get('about:blank')
        self.driver.get(f'file://{path}')
        if self.before is not None:
            self.driver.execute_cdp_cmd('Page.removeScriptToEvaluateOnNewDocument', {'identifier': self.before})
            self.before = None
        self.wait('document.documentElement.dataset.ready === "true" || !document.getElementById("failure").hidden')

    def run(self, script, *arguments):
        return self.driver.execute_script(script, *arguments)

    def wait(self, condition):
        """Until a condition of the page holds."""
        end = time.monotonic() + PATIENCE
        while not self.run(f'return Boolean({condition})'):
            if time.monotonic() > end:
                raise AssertionError(f'the page never came to: {condition}')
            time.sleep(0.02)

    def settle(self):
        """Until what was asked of the page is done: rows are unpacked, filters are read after a pause in typing, and frames drawn."""
        self.driver.execute_async_script(
            'const done = arguments[0]; setTimeout(() => requestAnimationFrame(() => requestAnimationFrame(() => done())), 200);')

    def messages(self):
        return [entry['message'] for entry in self.driver.get_log('browser')]

    def requests(self):
        """What has been asked of the network since the last call, the page itself included."""
        urls = []
        for entry in self.driver.get_log('performance'):
            message = json.loads(entry['message'])['message']
            if message['method'] == 'Network.requestWillBeSent':
                urls.append(message['params']['request']['url'])
        return urls

    def marks(self):
        """When the page had drawn its findings and unpacked its rows, in milliseconds."""
        return self.run('return Object.fromEntries(performance.getEntriesByType("mark").map((m) => [m.name, Math.round(m.startTime)]))')
