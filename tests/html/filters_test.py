import unittest

from story import Story


class SearchAndFilters(Story):
    def test_search_finds_names_keys_and_values(self):
        self.open('fleet')
        self.search('CRYPTO')
        self.assertEqual('1 of 32 differences in 1 finding', self.result())
        self.assertEqual(['+ INV_Package'], self.names())
        self.search('9000')
        self.assertEqual(['~ INV_NetworkAdapter.MTU'], self.names())
        self.search('noexec')
        self.assertEqual(['~ INV_FileSystem.Options'], self.names())
        self.search('web36')
        self.assertEqual(['~ INV_Service.StartMode'], self.names())
        self.search('startmode')
        self.assertEqual(['− INV_Service', '~ INV_Service.StartMode'], self.names())

    def test_what_was_searched_for_is_marked(self):
        self.open('fleet').search('crypto')
        self.assertEqual('crypto', self.find('#list mark').text)

    def test_a_finding_counts_only_what_the_search_found(self):
        self.open('fleet').search('package07')
        self.assertEqual(['~ INV_Package.Version | package07: 1.7-1 → 1.7-1+security0 web21, web23 / '
                          '1.7-1+security1 web22 | web21..23 | 1 of 20'], self.findings())
        self.open_line('Version')
        self.assertEqual(1, len(self.instances()))

    def test_nothing_found_is_said(self):
        self.open('fleet').search('no such thing')
        self.assertEqual('None of 32 differences matches the filters.', self.result())
        self.assertEqual([], self.findings())

    def test_kinds_classes_properties_and_inventories_filter(self):
        self.open('fleet').click('#kinds button', '3')
        self.assertEqual(['− INV_Package', '− INV_Service'], self.names())
        self.click('#clear').choose('class', 'INV_Service')
        self.assertEqual('3 of 32 differences in 3 findings', self.result())
        self.choose('property', 'Started')
        self.assertEqual(['~ INV_Service.Started'], self.names())
        self.click('#clear').choose('inventory', 'web23')
        self.assertEqual('22 of 32 differences in 2 findings', self.result())

    def test_a_class_offers_its_own_properties(self):
        self.open('fleet').choose('class', 'INV_Service')
        self.assertEqual(['All properties', 'StartMode', 'Started'], self.find('#property').text.split('\n'))

    def test_clear_shows_everything_again(self):
        self.open('fleet').choose('class', 'INV_Service').search('ssh').click('#clear')
        self.assertEqual('32 differences in 9 findings', self.result())
        self.assertEqual('', self.find('#search').get_property('value'))
        self.assertFalse(self.find('#clear').is_enabled())

    def test_order_is_largest_first_or_rarest_first_or_by_class(self):
        self.open('trio')
        counts = [int(finding.split(' | ')[-1]) for finding in self.findings()]
        self.assertEqual(sorted(counts, reverse=True), counts)
        self.open('fleet').choose('order', 'Rarest value first')
        names = self.names()
        self.assertLess(names.index('+ INV_Package'), names.index('~ INV_NetworkAdapter.MTU'))
        self.assertLess(names.index('~ INV_NetworkAdapter.MTU'), names.index('~ INV_Package.Version'))
        self.choose('order', 'By class')
        classes = [name.split(' ')[1].split('.')[0] for name in self.names()]
        self.assertEqual(sorted(classes), classes)


class TheTableOfClasses(Story):
    def numbers(self):
        return self.browser.run('''return [...document.querySelector(".matrix").rows].map((row) =>
            [...row.cells].map((cell) => cell.innerText.trim()).join(" "))''')

    def test_it_counts_by_kind_and_inventory(self):
        self.open('trio')
        self.assertEqual(['Class − + ~ bookworm-updates trixie', 'DEB_Package 3 3 25 8 30', 'DEB_PackageDependency 2 · 2 · 4'],
                         [line.replace('only elsewhere', '').replace('missing elsewhere', '').replace('changed', '').replace('  ', ' ')
                          .replace('\n0', '').replace('\n', '') for line in self.numbers()])

    def test_a_number_filters_and_a_second_click_shows_all_again(self):
        self.open('fleet').click('.matrix td button', 'INV_Package, web23')
        self.assertEqual('22 of 32 differences in 2 findings', self.result())
        self.assertEqual('INV_Package', self.find('#class').get_property('value'))
        self.assertEqual('true', self.find('.matrix td button[aria-pressed=true]').get_attribute('aria-pressed'))
        self.click('.matrix td button', 'INV_Package, web23')
        self.assertEqual('32 differences in 9 findings', self.result())

    def test_a_number_says_the_share_that_its_shade_shows(self):
        self.open('fleet')
        label = self.find('.matrix td button[aria-label^="INV_NetworkAdapter, web19"]').get_attribute('aria-label')
        self.assertEqual('INV_NetworkAdapter, web19, 4 differences in 4 of 4 instances, 100 %', label)
        shades = {self.browser.run('return getComputedStyle(arguments[0]).backgroundColor', button)
                  for button in self.browser.driver.find_elements('css selector', '.matrix .shaded button')}
        self.assertGreater(len(shades), 2)

    def test_inventories_without_differences_are_shown_on_demand(self):
        self.open('fleet')
        self.assertEqual(12, len(self.browser.driver.find_elements('css selector', '.matrix thead .inventory')) + 1)
        self.click('.more', 'Show 28 more inventories')
        self.assertEqual(39, len(self.browser.driver.find_elements('css selector', '.matrix thead .inventory')))


if __name__ == '__main__':
    unittest.main()
