import unittest

from story import PICTURES, Story, page

WIDTHS = (1440, 800, 390)

# The distances that readers may set (WCAG 2.2, 1.4.12); they stand for wider fonts and longer paths, too.
SPACING = '''
const sheet = new CSSStyleSheet();
sheet.replaceSync("* { line-height: 1.5 !important; letter-spacing: .12em !important; word-spacing: .16em !important; }");
document.adoptedStyleSheets = [sheet];
window.dispatchEvent(new Event("resize"));
'''

# The contrast of each text on the page with what is behind it, where it is below what WCAG asks for.
CONTRAST = '''
const parse = (color) => { const canvas = document.createElement("canvas"); canvas.width = canvas.height = 1;
    const context = canvas.getContext("2d", { willReadFrequently: true }); context.fillStyle = color; context.fillRect(0, 0, 1, 1);
    return [...context.getImageData(0, 0, 1, 1).data]; };
const cache = new Map();
const color = (text) => cache.get(text) || cache.set(text, parse(text)).get(text);
const light = (rgb) => { const [r, g, b] = rgb.slice(0, 3).map((c) => c / 255).map((c) => c <= 0.03928 ? c / 12.92 : ((c + 0.055) / 1.055) ** 2.4);
    return 0.2126 * r + 0.7152 * g + 0.0722 * b; };
const behind = (node) => { for (let at = node; at; at = at.parentElement) { const found = color(getComputedStyle(at).backgroundColor);
    if (found[3] === 255) { return found; } } return [255, 255, 255, 255]; };
const low = [];
let seen = 0;
const walker = document.createTreeWalker(document.body, NodeFilter.SHOW_TEXT);
while (walker.nextNode()) {
    const node = walker.currentNode.parentElement;
    if (!walker.currentNode.textContent.trim() || node.closest("script, noscript, :disabled, [hidden]") || !node.checkVisibility()) { continue; }
    const [one, other] = [light(color(getComputedStyle(node).color)), light(behind(node))].sort((a, b) => b - a);
    const contrast = (one + 0.05) / (other + 0.05);
    seen += 1;
    if (contrast < 4.5) { low.push(contrast.toFixed(2) + " " + node.className + " " + walker.currentNode.textContent.slice(0, 40)); }
}
return [seen, low];
'''


class HowItLooks(Story):
    def test_pictures_at_three_widths_in_light_and_dark(self):
        PICTURES.mkdir(parents=True, exist_ok=True)
        for name, finding in (('pair', 'Started'), ('trio', 'MultiArch'), ('fleet', 'INV_NetworkAdapter')):
            for width in WIDTHS:
                for dark in (False, True):
                    self.open(name, width=width, height=1400, dark=dark).open_line(finding)
                    self.browser.run('document.activeElement.blur(); window.scrollTo(0, 0)')
                    picture = PICTURES / f'{name}-{width}{"-dark" if dark else ""}.png'
                    self.assertTrue(self.browser.driver.save_screenshot(str(picture)))
                    self.assertGreater(picture.stat().st_size, 20_000)

    def test_nothing_is_wider_than_the_window(self):
        for name in ('pair', 'trio', 'fleet', 'hostile'):
            for width in (*WIDTHS, 320):
                self.open(name, width=width)
                self.click('#list .finding .line').click('#list .rule-button')
                self.assertLessEqual(self.browser.run('return document.documentElement.scrollWidth'), width, name)
                self.browser.run(SPACING)
                self.browser.settle()
                self.assertLessEqual(self.browser.run('return document.documentElement.scrollWidth'), width, f'{name} with wide text')

    def test_lines_do_not_lie_on_each_other(self):
        for width in WIDTHS:
            self.open('fleet', width=width).open_line('INV_Package.Version').open_instance('package01')
            gaps = self.browser.run('''const items = [...document.querySelectorAll("#list .item")].map((item) => item.getBoundingClientRect());
                return items.slice(1).map((item, i) => Math.round(item.top - items[i].bottom))''')
            self.assertGreater(len(gaps), 10)
            self.assertEqual({0}, set(gaps))

    def test_contrast_is_enough_in_light_and_dark(self):
        for name in ('fleet', 'trio'):
            for dark in (False, True):
                self.open(name, dark=dark).click('#list .finding .line').click('#list .rule-button').click('#list .row .line')
                seen, low = self.browser.run(CONTRAST)
                self.assertGreater(seen, 100)
                self.assertEqual([], low)

    def test_dark_mode_has_a_dark_page(self):
        self.open('pair', dark=True)
        self.assertEqual('rgb(20, 23, 27)', self.browser.run('return getComputedStyle(document.body).backgroundColor'))
        self.open('pair')
        self.assertEqual('rgb(255, 255, 255)', self.browser.run('return getComputedStyle(document.body).backgroundColor'))

    def test_targets_are_large_enough(self):
        self.open('fleet', width=390).click('#list .finding .line')
        small = self.browser.run('''return [...document.querySelectorAll("button, select, input, summary, nav a")].filter((target) => target.checkVisibility())
            .map((target) => [target.textContent.slice(0, 20), target.getBoundingClientRect()]).filter(([, box]) => box.width < 24 || box.height < 24)
            .map(([text, box]) => `${text} ${box.width} x ${box.height}`)''')
        self.assertEqual([], small)

    def test_larger_text_and_wider_spacing_lose_nothing(self):
        self.open('fleet', width=800).open_line('INV_NetworkAdapter')
        self.browser.run('document.documentElement.style.fontSize = "30px"')
        self.browser.settle()
        self.assertLessEqual(self.browser.run('return document.documentElement.scrollWidth'), 800)
        gaps = self.browser.run('''const items = [...document.querySelectorAll("#list .item")].map((item) => item.getBoundingClientRect());
            return items.slice(1).map((item, i) => Math.round(item.top - items[i].bottom))''')
        self.assertEqual({0}, set(gaps))


class OnPaper(Story):
    def test_all_lines_stand_one_behind_the_other_without_controls(self):
        self.open('fleet').open_line('INV_NetworkAdapter')
        self.browser.run('''addEventListener("beforeprint", () => { window.printed = [document.querySelectorAll("#list .item").length,
            getComputedStyle(document.querySelector("#list .item")).position, document.getElementById("printed").hidden]; })''')
        self.assertGreater(len(self.browser.driver.print_page()), 10_000)
        self.assertEqual([14, 'static', True], self.browser.run('return window.printed'))
        self.browser.settle()
        self.assertEqual('absolute', self.browser.run('return getComputedStyle(document.querySelector("#list .item")).position'))
        self.assertEqual('32 differences in 9 findings', self.result())

    def test_controls_are_not_printed(self):
        self.open('fleet')
        self.browser.driver.execute_cdp_cmd('Emulation.setEmulatedMedia', {'media': 'print'})
        shown = [self.find(selector).is_displayed() for selector in ('#filters', 'nav', '#list-hint', '#list .line')]
        self.browser.driver.execute_cdp_cmd('Emulation.setEmulatedMedia', {'media': ''})
        self.assertEqual([False, False, False, True], shown)


if __name__ == '__main__':
    unittest.main()
