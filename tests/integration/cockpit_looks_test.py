"""Each view in light and dark: what axe-core finds, how narrow it may be, pictures of it."""

from support import cockpit
from support.cockpit import PageTest

VIEWS = ('tree', 'users', 'groups', 'drivers', 'log', 'doctor', 'host')

# Controls that are cut off: outside of the page, and in nothing that scrolls sideways.
CUT_OFF = '''
const scrolls = element => element && element !== document.body &&
    (/auto|scroll/.test(getComputedStyle(element).overflowX) || scrolls(element.parentElement));
return [...document.querySelectorAll('button, input, select, a, textarea')]
    .filter(element => element.checkVisibility() && !element.closest('.pf-v6-screen-reader'))
    .filter(element => element.getBoundingClientRect().right > window.innerWidth + 1 && !scrolls(element))
    .map(element => element.outerHTML.slice(0, 200));
'''


class Looks(PageTest):
    @classmethod
    def setUpClass(cls):
        super().setUpClass()
        cls.browser.open()

    def tearDown(self):
        self.browser.size(1280, 900)
        self.browser.scheme('light')

    def view(self, name):
        self.browser.click(f'#tab-{name}')
        self.browser.shown(f'#panel-{name}')
        self.browser.wait('return !document.querySelector("#panel-" + arguments[0] + " [aria-busy=true]")', name)

    def nothing_found(self, scheme):
        self.browser.scheme(scheme)
        for name in VIEWS:
            with self.subTest(name):
                self.view(name)
                self.assertEqual(self.browser.axe(), [])
                self.browser.picture(f'{name}-{scheme}')

    def test_nothing_serious_found_in_light(self):
        self.nothing_found('light')

    def test_nothing_serious_found_in_dark(self):
        self.nothing_found('dark')

    def test_fits_every_width(self):
        for width in (400, 800, 1280, 2000):
            self.browser.size(width, 900)
            for name in VIEWS:
                with self.subTest(name, width=width):
                    self.view(name)
                    self.assertEqual(self.browser.run('return document.documentElement.scrollWidth'), width)
                    self.assertEqual(self.browser.run(CUT_OFF), [])
                    self.browser.picture(f'{name}-{width}')

    def test_keeps_to_its_policy(self):
        for name in VIEWS:
            self.view(name)
        self.assertEqual(self.browser.refused(), [])
        self.assertEqual(self.browser.complaints(), [])


def setUpModule():
    cockpit.install_cockpit()


if __name__ == '__main__':
    cockpit.main()
