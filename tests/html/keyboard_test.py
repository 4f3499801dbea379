import unittest

from story import Story


class WithTheKeyboardAlone(Story):
    def to(self, selector):
        """Tabs from the beginning of the page until the element has the focus; every stop on the way must show it."""
        self.browser.run('document.activeElement.blur(); window.scrollTo(0, 0)')
        for _ in range(60):
            self.press('TAB')
            seen = self.browser.run('''const at = document.activeElement; const style = getComputedStyle(at);
                return [at.matches(arguments[0]), style.outlineStyle !== "none" && parseFloat(style.outlineWidth) >= 2]''', selector)
            self.assertTrue(seen[1], 'a focus that is not visible: ' + self.browser.run('return document.activeElement.outerHTML.slice(0, 100)'))
            if seen[0]:
                return self
        raise AssertionError(f'{selector} cannot be reached')

    def test_the_first_stop_leads_to_the_findings(self):
        self.open('fleet').press('TAB')
        self.assertEqual('Skip to the findings', self.focused())

    def test_everything_can_be_reached(self):
        self.open('fleet')
        for selector in ['nav a', '.matrix button', '#search', '#kinds button', '#class', '#property', '#inventory', '#order',
                         '#list .line', '#inventories-table']:
            self.to(selector)

    def test_the_list_is_one_stop_and_arrows_move_in_it(self):
        self.open('fleet').to('#list .line')
        self.assertIn('INV_Package.Version', self.focused())
        self.press('ARROW_DOWN')
        self.assertIn('INV_NetworkAdapter.MTU', self.focused())
        self.press('ARROW_RIGHT', 'ARROW_RIGHT')
        self.assertEqual('eth0 1500 → 9000', self.focused())
        self.press('ARROW_DOWN', 'ENTER')
        self.assertEqual('9000: web19', self.table()[1])
        self.press('ARROW_LEFT')
        self.assertEqual([], self.browser.driver.find_elements('css selector', '#list .values'))
        self.press('ARROW_LEFT')
        self.assertIn('INV_NetworkAdapter.MTU', self.focused())
        self.press('ARROW_LEFT')
        self.assertEqual([], self.instances())
        self.press('END')
        self.assertIn('INV_User', self.focused())
        self.press('HOME')
        self.assertIn('INV_Package.Version', self.focused())

    def test_the_rule_is_reached_from_its_finding(self):
        self.open('fleet').to('#list .line').press('ARROW_RIGHT', 'TAB')
        self.assertEqual('Rule to leave this out', self.focused())
        self.press('ENTER')
        self.assertEqual('Rule to leave this out', self.focused())
        self.press('TAB', 'TAB')
        self.assertEqual('Copy rule', self.focused())

    def test_arrows_move_in_the_table_of_classes(self):
        self.open('fleet').to('.matrix button').press('ARROW_RIGHT', 'ARROW_DOWN')
        self.assertEqual('INV_NetworkAdapter, changed, 4 differences', self.browser.run('return document.activeElement.getAttribute("aria-label")'))
        self.press('ENTER')
        self.assertEqual(['~ INV_NetworkAdapter.MTU'], self.names())

    def test_the_focus_is_never_under_the_filters_and_never_lost(self):
        self.open('fleet', height=420).to('#list .line').press('ARROW_RIGHT', *['ARROW_DOWN'] * 12, *['ARROW_UP'] * 9)
        covered = self.browser.run('''const line = document.activeElement.getBoundingClientRect();
            return [line.top >= document.getElementById("filters").getBoundingClientRect().bottom - 1, line.bottom <= innerHeight]''')
        self.assertEqual([True, True], covered)
        self.browser.run('window.scrollTo(0, document.body.scrollHeight)')
        self.browser.settle()
        self.assertEqual('BUTTON', self.browser.run('return document.activeElement.tagName'))


class ForScreenReaders(Story):
    def test_landmarks_headings_and_names(self):
        self.open('fleet')
        self.assertEqual([1, 1, 1, 5], self.browser.run('''return ["main", "header", "nav[aria-label]", "main > section[aria-labelledby]:not([hidden])"]
            .map((selector) => document.querySelectorAll(selector).length)'''))
        self.assertEqual(['H1 web01 against 39 others: 32 differences', 'H2 Classes and inventories', 'H2 Findings', 'H2 Inventories', 'H2 Rules', 'H2 Coverage'],
                         self.browser.run('return [...document.querySelectorAll("h1, h2")].filter((head) => head.checkVisibility()).map((head) => head.tagName + " " + head.textContent)'))
        nameless = self.browser.run('''return [...document.querySelectorAll("button, input, select, [tabindex]")].filter((control) =>
            !(control.textContent.trim() || control.getAttribute("aria-label") || control.getAttribute("aria-labelledby") || control.labels?.length))
            .map((control) => control.outerHTML)''')
        self.assertEqual([], nameless)

    def test_lines_say_whether_they_are_open_and_which_they_are(self):
        self.open('fleet')
        line = self.find('#list .finding .line')
        self.assertEqual('false', line.get_attribute('aria-expanded'))
        self.open_line('INV_Package.Version')
        self.assertEqual('true', self.find('#list .finding .line').get_attribute('aria-expanded'))
        item = self.find('#list .row')
        self.assertEqual(['listitem', '2', '3', '30'], [item.get_attribute(name) for name in ('role', 'aria-level', 'aria-posinset', 'aria-setsize')])

    def test_the_number_of_results_is_announced(self):
        self.open('fleet')
        self.assertEqual(['status', 'polite'], [self.find('#result').get_attribute(name) for name in ('role', 'aria-live')])

    def test_tables_have_captions_and_headers(self):
        self.open('fleet').open_line('INV_FileSystem')
        faults = self.browser.run('''return [...document.querySelectorAll("table")].filter((table) => !table.caption ||
            [...table.querySelectorAll("th")].some((head) => !head.scope)).map((table) => table.outerHTML.slice(0, 200))''')
        self.assertEqual([], faults)

    def test_signs_have_words(self):
        self.open('pair')
        self.assertIn('missing elsewhere: ', self.find('#list .kind .sr').get_property('textContent'))


if __name__ == '__main__':
    unittest.main()
