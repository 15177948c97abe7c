"""Each view in light and dark: what axe-core finds, at which widths it fits, pictures of it."""

from support import cockpit
from support.cockpit import PageTest

# Keyed by name: the path in the page's address, and an element that exists once the view is complete.
VIEWS = {
    'tree': ('tree/user%3Acarl', '#detail [data-property=login-shell]'),
    'users': ('users', '#users-table tr[data-name=carl]'),
    'account': ('users/carl', '#account #user-shell'),
    'groups': ('groups', '#groups-table tr[data-name=team]'),
    'group': ('groups/team', '#group #group-delete'),
    'drivers': ('drivers', '#drivers-table tr[data-name=two]'),
    'log': ('log', '.mi-log__line:nth-child(3)'),
    'doctor': ('doctor', '#doctor-findings li'),
    'host': ('host', '.mi-chart polyline'),
}

# Returns the controls that are cut off: outside the page and in nothing that scrolls sideways.
CUT_OFF = '''
const scrolls = element => element && element !== document.body &&
    (/auto|scroll/.test(getComputedStyle(element).overflowX) || scrolls(element.parentElement));
return [...document.querySelectorAll('button, input, select, a, textarea')]
    .filter(element => element.checkVisibility() && !element.closest('.pf-v6-screen-reader'))
    .filter(element => element.getBoundingClientRect().right > window.innerWidth + 1 && !scrolls(element))
    .map(element => element.outerHTML.slice(0, 200));
'''


class Looks(PageTest):
    def setUp(self):
        self.browser.open()

    def tearDown(self):
        self.browser.size(1280, 900)
        self.browser.scheme('light')

    def view(self, name):
        path, complete = VIEWS[name]
        self.browser.run('location.hash = "#/" + arguments[0]', path)
        self.browser.shown(complete)

    def open_dialog(self, button, **fields):
        """Opens the preview of a change of the view's account."""
        self.view('account')
        self.browser.click(button)
        for name, text in fields.items():
            self.browser.type(f'#field-{name}', text)
        self.browser.click('#preview-run')
        self.browser.see('#preview', 'Commands that would run')

    def close_dialog(self):
        self.browser.click('#preview-cancel')
        self.browser.gone('#preview')

    def assert_nothing_found(self, name):
        self.browser.picture(name)
        self.assertEqual(self.browser.axe(), [])

    def assert_nothing_serious_found(self, scheme):
        self.browser.scheme(scheme)
        for name in VIEWS:
            with self.subTest(name):
                self.view(name)
                self.assert_nothing_found(f'{name}-{scheme}')
        self.open_dialog('#user-shell', shell='/bin/bash')
        self.assert_nothing_found(f'change-{scheme}')
        self.close_dialog()
        self.open_dialog('#user-delete')
        self.assert_nothing_found(f'delete-{scheme}')
        self.close_dialog()

    def test_axe_finds_nothing_serious_in_light(self):
        self.assert_nothing_serious_found('light')

    def test_axe_finds_nothing_serious_in_dark(self):
        self.assert_nothing_serious_found('dark')

    def assert_fits_every_width(self, name):
        for width in (2000, 800, 400):
            with self.subTest(name, width=width):
                self.browser.size(width, 900)
                self.assertEqual(self.browser.run('return document.documentElement.scrollWidth'), width)
                self.assertEqual(self.browser.run(CUT_OFF), [])
        self.browser.picture(f'{name}-narrow')

    def test_fits_every_width(self):
        for name in VIEWS:
            self.view(name)
            self.assert_fits_every_width(name)
        self.open_dialog('#user-delete')
        self.assert_fits_every_width('delete')
        self.close_dialog()

    def test_shows_the_chosen_tab_in_a_narrow_window(self):
        self.browser.size(400, 900)
        for name in ('doctor', 'tree'):
            self.view(name)
            tab = self.browser.run(f'return document.getElementById("tab-{name}").getBoundingClientRect()')
            self.assertGreaterEqual(tab['left'], 0, name)
            self.assertLessEqual(tab['right'], 400, name)

    def test_violates_no_policy(self):
        for name in VIEWS:
            self.view(name)
        self.assertEqual(self.browser.refused(), [])
        self.assertEqual(self.browser.complaints(), [])


def setUpModule():
    cockpit.install_cockpit()


if __name__ == '__main__':
    cockpit.main()
