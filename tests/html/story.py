"""What the stories share: pages made once, one browser, and verbs for what a person does and sees."""
import atexit
import os
import pathlib
import subprocess
import tempfile
import unittest

from selenium.webdriver.common.by import By
from selenium.webdriver.common.keys import Keys

import inventories
from browser import Browser

PROGRAM = os.environ.get('CIMDELTA_PROGRAM', 'build/dev/bin/cimdelta')
ROOT = pathlib.Path(os.environ.get('CIMDELTA_ROOT', '.')).resolve()
PICTURES = pathlib.Path(os.environ.get('CIMDELTA_PICTURES', ROOT / 'build/html-pictures'))

RULES = '''<DifftoolSpec version="1.0">
  <class name="INV_Package" default="include">
    <excludelist><value>Vendor</value></excludelist>
  </class>
  <class name="INV_Service" default="exclude">
    <includelist><value>Started</value></includelist>
  </class>
  <class name="&lt;root&gt;" default="include"/>
  <class name="INV_User" default="include"/>
</DifftoolSpec>
'''


def shared(make):
    """Makes something when it is first asked for, and keeps it."""
    made = []

    def get():
        if not made:
            made.append(make())
        return made[0]
    return get


@shared
def browser():
    made = Browser()
    atexit.register(made.quit)
    return made


@shared
def scratch():
    folder = tempfile.TemporaryDirectory(prefix='cimdelta-html-')
    atexit.register(folder.cleanup)
    return pathlib.Path(folder.name)


def compare(arguments, output):
    """Compares, and returns the exit status."""
    command = [PROGRAM, 'compare', '-o', 'html', '--output', str(output), *map(str, arguments)]
    done = subprocess.run(command, capture_output=True, text=True, check=False)
    if done.returncode == 2:
        raise AssertionError(f'{command}: {done.stderr}')
    return done.returncode


def arguments_of(name, folder):
    if name == 'trio':
        examples = ROOT / 'data/examples'
        return ['--spec', examples / 'rules.xml', examples / 'bookworm.xml', examples / 'bookworm-updates.xml.xz', examples / 'trixie.xml.xz']
    if name == 'ruled':
        rules = folder / 'rules.xml'
        rules.write_text(RULES, encoding='utf-8')
        return ['--spec', rules, *inventories.pair(folder)]
    if name == 'equal':
        return [inventories.Server().write(folder / 'one.xml'), inventories.Server().write(folder / 'other.xml')]
    if name == 'only':
        return ['--only', '~', '--class', 'INV_Service', *inventories.lacking(folder)]
    return getattr(inventories, name)(folder)


def page(name, made={}):
    """The path of the page of that comparison."""
    if name not in made:
        folder = scratch() / name
        folder.mkdir()
        made[name] = folder / 'report.html'
        compare(arguments_of(name, folder), made[name])
    return made[name]


class Story(unittest.TestCase):
    """Every story ends with a look at the console and at the network."""

    def setUp(self):
        self.browser = browser()

    def tearDown(self):
        self.assertEqual([], self.browser.messages(), 'the console is not empty')
        self.assertEqual([], [url for url in self.browser.requests() if not url.startswith(('file://', 'about:'))], 'the page asked the network')

    def open(self, name, **look):
        self.browser.look(**look)
        self.browser.open(page(name))
        return self

    # What a person does.

    def find(self, selector):
        return self.browser.driver.find_element(By.CSS_SELECTOR, selector)

    def search(self, text):
        field = self.find('#search')
        field.clear()
        field.send_keys(text)
        self.browser.settle()
        return self

    def choose(self, field, text):
        options = self.find(f'#{field}').find_elements(By.TAG_NAME, 'option')
        next(option for option in options if option.text == text).click()
        self.browser.settle()
        return self

    def click(self, selector, text=None):
        elements = self.browser.driver.find_elements(By.CSS_SELECTOR, selector)
        chosen = [element for element in elements if text is None or text in element.text or text in (element.get_attribute('aria-label') or '')]
        self.assertTrue(chosen, f'no {selector} with "{text}" is there')
        self.browser.run('arguments[0].scrollIntoView({ block: "center" })', chosen[0])
        chosen[0].click()
        self.browser.settle()
        return self

    def open_line(self, text):
        return self.click('#list .line', text)

    def open_instance(self, text):
        return self.click('#list .row .line', text)

    def press(self, *keys):
        for key in keys:
            self.browser.driver.switch_to.active_element.send_keys(getattr(Keys, key, key))
            self.browser.settle()
        return self

    # What a person sees.

    def result(self):
        return self.find('#result').text

    def findings(self):
        """The lines of the findings that are drawn: sign, name, summary, inventories and number."""
        return self.browser.run('''return [...document.querySelectorAll("#list .finding .line")].map((line) => {
            const text = (part) => line.querySelector(":scope > " + part).innerText.replace(/\\s+/g, " ").trim();
            const count = line.querySelector(".count").firstChild.textContent + line.querySelector(".of").textContent;
            return [line.querySelector(".kind").firstChild.textContent, text(".name"), "|", text(".summary"), "|", text(".who"), "|", count]
                .filter((part) => part !== "").join(" ");
        })''')

    def names(self):
        return [finding.split(' | ')[0] for finding in self.findings()]

    def instances(self):
        return self.browser.run('''return [...document.querySelectorAll("#list .row .line")]
            .map((line) => line.innerText.replace(/\\s+/g, " ").trim())''')

    def table(self, selector='#list .values'):
        """The lines of a table, with the inventories that have a value behind it."""
        return self.browser.run('''const table = document.querySelector(arguments[0]);
            const heads = [...table.tHead.rows[0].cells].map((cell) => cell.firstChild.textContent);
            return [...table.tBodies[0].rows].map((row) => {
                const value = row.cells[0].querySelector(".value");
                const holders = heads.filter((head, i) => i > 0 && row.cells[i].textContent !== "");
                return (value || row.cells[0]).textContent + ": " + holders.join(", ");
            })''', selector)

    def focused(self):
        return self.browser.run('return document.activeElement.innerText.replace(/\\s+/g, " ").trim()')
