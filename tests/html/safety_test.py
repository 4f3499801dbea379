import unittest

import inventories
from story import Story, page


class TextsFromInventories(Story):
    def test_they_are_shown_and_never_run(self):
        self.open('hostile').open_line('INV_Text.Value')
        self.assertEqual('a → b: 10 differences', self.browser.driver.title)
        self.assertEqual(0, self.browser.run('return document.querySelectorAll("img, #list script, iframe, object").length'))
        shown = ' '.join(self.instances())
        for text in ['<script>document.title', '</script><img src=x onerror=', '&lt;b&gt; &amp; <!-- --> ]]>', 'a\\u2028b', '\\\\u0000', '{{script}} ${1} `x`',
                     '\\u202etxt.exe', 'Ünï 😀 \U0001F680']:
            self.assertIn(text, shown)

    def test_each_of_them_is_found(self):
        self.open('hostile')
        for text in ['<script>', '</script>', "'quoted'", '\\u2028', '&lt;b&gt;', '\\u0000', '${1}', '\\u202e', '\U0001F680']:
            self.search(text)
            self.assertNotIn('None', self.result(), text)

    def test_they_stand_in_the_tables_too(self):
        self.open('hostile').search('<script>').open_line('only in b')
        self.assertIn('</script><img src=x', self.find('#list .contents-table').text)
        self.assertEqual(0, self.browser.run('return document.querySelectorAll("img").length'))

    def test_the_file_holds_none_of_them_as_markup(self):
        source = page('hostile').read_text(encoding='utf-8')
        for text in inventories.HOSTILE:
            if len(text) > 8 and text not in ('{{script}} ${1} `x`',):
                self.assertNotIn(text, source)
        self.assertEqual(3, source.count('</script>'))


class ThePolicy(Story):
    def test_only_the_pages_own_script_and_style_run(self):
        self.open('pair')
        policy = self.find('meta[http-equiv=Content-Security-Policy]').get_attribute('content')
        self.assertRegex(policy, "^default-src 'none'; script-src 'sha256-[^']*'; style-src 'sha256-[^']*'; base-uri 'none'; form-action 'none'$")

    def test_a_script_that_is_added_is_refused(self):
        self.open('pair')
        self.browser.run('''const added = document.createElement("script"); added.textContent = "window.wasRun = true";
            document.body.append(added)''')
        self.assertFalse(self.browser.run('return Boolean(window.wasRun)'))
        refused = self.browser.messages()
        self.assertEqual(1, len(refused))
        self.assertIn('Content Security Policy', refused[0])

    def test_the_page_names_no_address(self):
        source = page('pair').read_text(encoding='utf-8')
        self.assertNotRegex(source, r'https?://|@import|url\(|\beval\(|new Function|innerHTML|insertAdjacentHTML|document\.write')


class OlderBrowsers(Story):
    def test_base64_is_unpacked_without_a_newer_function(self):
        self.browser.run_first('delete Uint8Array.fromBase64')
        self.open('pair')
        self.assertEqual('4 differences in 4 findings', self.result())

    def test_a_browser_that_cannot_unpack_is_told_so(self):
        self.browser.run_first('delete globalThis.DecompressionStream')
        self.open('pair')
        self.assertIn('lacks DecompressionStream', self.find('#failure').text)


if __name__ == '__main__':
    unittest.main()
