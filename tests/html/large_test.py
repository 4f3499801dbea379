import unittest

from story import Story


class ThreeHundredThousandDifferences(Story):
    def items(self):
        return self.browser.run('return document.querySelectorAll("#list .item").length')

    def test_the_page_opens_and_draws_only_what_is_seen(self):
        self.open('large')
        self.assertEqual('300,000 differences in 12 findings', self.result())
        self.click('#list .finding .line')
        self.assertLess(self.items(), 80)
        marks = self.browser.marks()
        print(f'\nlarge page: findings drawn after {marks["drawn"]} ms, rows unpacked after {marks["unpacked"]} ms')

    def test_a_finding_opens_to_all_of_its_instances(self):
        self.open('large').click('#list .finding .line')
        self.assertEqual('25013', self.find('#list .item').get_attribute('aria-setsize'))
        self.press('END')
        self.assertIn('INV_Part1.P5', self.focused())
        self.press('HOME', 'ARROW_RIGHT', *['ARROW_DOWN'] * 3)
        self.assertIn('part-000002', self.focused())
        self.assertLess(self.items(), 80)

    def test_all_of_them_open_at_once_and_the_last_can_be_reached(self):
        for width in (1440, 390):
            self.open('large', width=width)
            self.browser.run('for (const line of document.querySelectorAll("#list .finding .line")) { line.click(); }')
            self.browser.settle()
            self.assertEqual('300024', self.find('#list .item').get_attribute('aria-setsize'))
            self.find('#list .line').send_keys('\ue010')
            self.browser.settle()
            self.assertRegex(self.focused(), 'part-[0-9]+ value [0-9]+ of 5 in before')
            self.assertEqual('300024', self.browser.run('return document.activeElement.closest(".item").getAttribute("aria-posinset")'))
            box = self.browser.run('const box = document.activeElement.getBoundingClientRect(); return [box.top >= 0, box.bottom <= innerHeight]')
            self.assertEqual([True, True], box)
            self.assertLess(self.items(), 80)

    def test_search_and_filters_look_at_every_row(self):
        self.open('large').search('part-049999')
        self.assertEqual('6 of 300,000 differences in 6 findings', self.result())
        self.click('#clear').choose('property', 'P3')
        self.assertEqual('50,000 of 300,000 differences in 2 findings', self.result())
        self.choose('class', 'INV_Part1')
        self.assertEqual('25,000 of 300,000 differences in 1 finding', self.result())

    def test_the_end_of_the_list_can_be_scrolled_to(self):
        self.open('large').click('#list .finding .line')
        self.browser.run('window.scrollTo(0, document.getElementById("list").getBoundingClientRect().bottom + scrollY - innerHeight)')
        self.browser.settle()
        self.assertIn('INV_Part1.P5', self.names()[-1])


if __name__ == '__main__':
    unittest.main()
