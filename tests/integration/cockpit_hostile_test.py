"""Texts of the machine that look like markup or scripts, and what the page's policy permits."""

import re
import urllib.request

from support import cockpit
from support.cockpit import PageTest

MARKUP = '<img src=x onerror="window.ran=1"><b>bold</b>'
SCRIPT = '<script>window.ran=1</script>'
CONTROLS = 'bell \a escape \x1b[31m back \b\b end \u202etxt.exe'


class Hostile(PageTest):
    @classmethod
    def prepare(cls):
        cockpit.lay_machine()
        passwd = cockpit.read('/etc/passwd').replace('Anna,,,', MARKUP).replace('Ben', SCRIPT)
        cockpit.write('/etc/passwd', passwd)
        cockpit.write('/var/log/messages', cockpit.log_lines([MARKUP, SCRIPT, CONTROLS]))

    def setUp(self):
        self.browser.open()
        self.browser.see('#tree', 'anna')

    def assert_only_text(self):
        self.assertIsNone(self.browser.run('return window.ran'))
        self.assertEqual(self.browser.find('img, b, body script'), [])
        self.assertEqual(self.browser.refused(), [])
        self.assertEqual(self.browser.complaints(), [])

    def test_markup_in_a_name_is_text(self):
        self.browser.see('#tree', MARKUP, SCRIPT)
        self.browser.click('#tree [data-address="user:anna"]')
        self.browser.see('#detail', MARKUP)
        self.assert_only_text()

    def test_script_in_the_log_is_text(self):
        self.browser.click('#tree [data-address=log] .mi-tree__toggle')
        self.browser.see('#tree', MARKUP, SCRIPT)
        self.browser.click('#tree [data-address="log:2"]')
        self.browser.see('#detail', SCRIPT)
        self.assert_only_text()

    def test_control_characters_are_made_visible(self):
        self.browser.click('#tree [data-address=log] .mi-tree__toggle')
        self.browser.see('#tree', 'bell')
        shown = self.browser.run('return document.getElementById("tree").textContent')
        self.assertNotRegex(shown, '[\x00-\x1f\x7f\u202e]')
        self.assert_only_text()

    def test_text_that_is_typed_is_no_markup_either(self):
        self.browser.type('#tree-search', MARKUP)
        self.browser.see('#tree', 'anna')
        self.browser.not_seen('#tree', 'carl')
        self.assert_only_text()


class Policy(PageTest):
    def test_permits_nothing_inline_and_no_other_place(self):
        with urllib.request.urlopen(f'{cockpit.ADDRESS}/cockpit/@localhost/mihost/index.html') as answer:
            policy = answer.headers['Content-Security-Policy']
            content = answer.read().decode()
        rules = dict(rule.strip().partition(' ')[::2] for rule in policy.split(';') if rule.strip())
        self.assertNotIn('unsafe', policy)
        self.assertNotIn('*', policy)
        self.assertIn("'none'", rules['default-src'])
        self.assertEqual(rules['script-src'].split()[0], "'self'")
        self.assertEqual(re.findall(r'<script>|<style|style=|\son\w+=|https?:', content), [])

    def test_refuses_what_is_inline(self):
        """The browser heeds it, so that the other tests can see a violation."""
        self.browser.open()
        self.browser.see('#tree', 'anna')
        self.browser.run(
            'const image = document.createElement("div"); image.innerHTML = arguments[0]; document.body.append(image)',
            MARKUP,
        )
        self.browser.wait('return window.refused.length > 0')
        self.assertIsNone(self.browser.run('return window.ran'))


def setUpModule():
    cockpit.install_cockpit()


if __name__ == '__main__':
    cockpit.main()
