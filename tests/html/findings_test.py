import unittest

from story import Story


class WhatThePageSays(Story):
    def test_a_pair_is_said_in_one_sentence_and_four_lines(self):
        self.open('pair')
        self.assertEqual('web01 → web07: 4 differences', self.find('h1').text)
        self.assertEqual('−1 only in web01|+2 only in web07|~1 changed value|3 of 6 classes differ', self.find('#counts').text.replace('\n', '|'))
        self.assertEqual('4 differences in 4 findings', self.result())
        self.assertEqual(['− INV_Package | package03Version 1.3-1, Vendor distribution | only in web01 | 1',
                          '+ INV_Package | cryptominerVersion 1.0-1, Vendor unknown | only in web07 | 1',
                          '~ INV_Service.Started | rsyslog: TRUE → FALSE | | 1',
                          '+ INV_User | malloryUID 1004, Groups {"mallory", "sudo"} | only in web07 | 1'], self.findings())

    def test_what_is_planted_in_a_fleet_is_found_by_reading(self):
        self.open('fleet')
        self.assertEqual('32 differences in 9 findings', self.result())
        self.assertEqual([
            '~ INV_Package.Version | 20 distinct changes, as package00: 1.0-1 → 1.0-1+security0 web21, web23 / 1.0-1+security1 web22 | web21..23 | 20',
            '~ INV_NetworkAdapter.MTU | 1500 → 9000eth0, eth1, eth2, eth3 | web19 | 4',
            '− INV_Package | package22, package23 | missing in web23 | 2',
            '~ INV_FileSystem.Options | /srv: -noexec | web31 | 1',
            '+ INV_Package | cryptominerVersion 1.0-1, Vendor unknown | only in web07 | 1',
            '− INV_Service | cronStarted TRUE, StartMode Automatic | missing in web34 | 1',
            '~ INV_Service.StartMode | ssh: Automatic → Manual | web36 | 1',
            '~ INV_Service.Started | rsyslog: TRUE → FALSE | web12 | 1',
            '+ INV_User | malloryUID 1004, Groups {"mallory", "sudo"} | only in web13, web14 | 1'], self.findings())

    def test_inventories_rules_and_coverage_are_named(self):
        self.open('ruled')
        inventories = self.find('#inventories-table').text
        self.assertIn('web01reference', inventories)
        self.assertIn('web07 4\n36 root/cimv2', inventories)
        self.assertRegex(self.find('#digest').text, '^[0-9a-f]{64}$')
        self.assertIn('rules.xml', self.find('#rules-text').text)
        self.click('#rules-text summary')
        self.assertIn('<value>Vendor</value>', self.find('#rules-text pre').text)
        self.assertIn('Compared: 6 classes', self.find('#coverage-text').text)

    def test_the_digest_is_that_of_the_file(self):
        import hashlib
        from story import RULES
        self.open('ruled')
        self.assertEqual(hashlib.sha256(RULES.encode()).hexdigest(), self.find('#digest').text)

    def test_a_pair_without_differences_says_so(self):
        self.open('equal')
        self.assertIn('No differences', self.find('h1').text)
        self.assertEqual('0 differences in 0 findings', self.result())
        self.assertFalse(self.find('#matrix').is_displayed())


class WhatAFindingHolds(Story):
    def test_a_change_opens_to_its_instances_and_these_to_their_values(self):
        self.open('fleet').open_line('INV_NetworkAdapter')
        self.assertEqual(['eth0 1500 → 9000', 'eth1 1500 → 9000', 'eth2 1500 → 9000', 'eth3 1500 → 9000'], self.instances())
        self.open_instance('eth1')
        others = ', '.join(f'web{i:02}' for i in range(1, 41) if i != 19)
        self.assertEqual([f'1500: {others}', '9000: web19'], self.table())

    def test_missing_is_a_value(self):
        self.open('fleet').search('package22').open_line('missing in web23')
        self.assertEqual(['missing: web23'], self.table()[1:])
        self.search('package00').open_line('Version')
        self.assertEqual(3, len(self.table()))

    def test_an_inventory_that_lacks_a_changed_instance_is_not_counted_with_the_reference(self):
        self.open('lacking').open_line('INV_Service.Started')
        self.assertEqual(['TRUE: a', 'FALSE: b', 'missing: c'], self.table())

    def test_what_an_option_leaves_out_is_still_missing_in_the_table(self):
        self.open('only')
        self.assertEqual('1 missing instance not shown (--only ~)', self.find('.not-shown').text)
        self.assertIn('1 of 2 other inventories differ in these', self.find('#counts').text)
        self.assertEqual(2, self.find('#counts').text.count('differ in these'))
        self.assertIn('Options narrowed what was compared: --class INV_Service', self.find('#rules-text').text)
        self.open_line('INV_Service.Started')
        self.assertEqual(['TRUE: a', 'FALSE: b', 'missing: c'], self.table())

    def test_an_instance_that_came_shows_what_it_holds_and_where_its_values_differ(self):
        self.open('fleet').open_line('INV_User')
        self.assertEqual('mallory', self.instances()[0].split(' ')[0])
        everyone = ', '.join(f'web{i:02}' for i in range(1, 41) if i not in (13, 14))
        self.assertEqual(['present: web13, web14', f'missing: {everyone}'], self.table())
        tables = self.browser.driver.find_elements('css selector', '#list .values')
        self.assertEqual(['Instance', 'Groups', 'UID', 'Property'], [table.find_element('css selector', 'th').text for table in tables])
        self.assertIn('1004', tables[-1].text)

    def test_an_only_instance_opens_with_its_finding(self):
        self.open('pair').open_line('Started')
        self.assertEqual(['TRUE: web01', 'FALSE: web07'], self.table())

    def test_a_second_click_closes(self):
        self.open('fleet').open_line('INV_NetworkAdapter').open_line('INV_NetworkAdapter')
        self.assertEqual([], self.instances())


class WhichRuleLeavesItOut(Story):
    def rule(self, finding):
        self.open_line(finding)
        self.click('#list .rule-button')
        return self.find('#list .rule p').text, self.find('#list .rule pre').text

    def test_without_rules_it_is_a_whole_file(self):
        self.open('fleet')
        said, xml = self.rule('INV_NetworkAdapter')
        self.assertIn('It is a whole file', said)
        self.assertEqual('<DifftoolSpec version="1.0">\n  <class name="&lt;root&gt;" default="include"/>\n'
                         '  <class name="INV_NetworkAdapter" default="include">\n    <excludelist>\n      <value>MTU</value>\n'
                         '    </excludelist>\n  </class>\n</DifftoolSpec>', xml.strip())

    def test_the_rule_copied_leaves_the_finding_out(self):
        import pathlib
        import subprocess
        from story import PROGRAM, page
        self.open('fleet')
        rules = page('fleet').parent / 'proposed.xml'
        rules.write_text(self.rule('INV_NetworkAdapter')[1], encoding='utf-8')
        inventories = sorted(map(str, pathlib.Path(page('fleet').parent).glob('web*.xml')))
        report = subprocess.run([PROGRAM, 'compare', '--spec', str(rules), *inventories], capture_output=True, text=True, check=False).stdout
        self.assertIn('28 differences', report)
        self.assertNotIn('MTU: 1500', report)

    def test_with_rules_the_place_is_named(self):
        self.open('ruled')
        said, xml = self.rule('INV_Service')
        self.assertIn('take Started out of the list at line 6', said)
        self.assertEqual('<excludelist>\n      <value>Started</value>\n    </excludelist>', xml.strip())

    def test_instances_can_only_be_left_out_with_their_class(self):
        self.open('pair')
        said, xml = self.rule('mallory')
        self.assertIn('Rules cannot leave out single instances', said)
        self.assertIn('<class name="INV_User" default="exclude"/>', xml)

    def test_a_click_copies_it(self):
        self.open('fleet')
        _, xml = self.rule('INV_NetworkAdapter')
        self.click('#list .copy')
        self.assertEqual('Copied', self.find('#list .copy').text)
        self.find('#search').send_keys('\ue009v\ue000')
        self.assertEqual(' '.join(xml.split()), ' '.join(self.find('#search').get_property('value').split()))


if __name__ == '__main__':
    unittest.main()
