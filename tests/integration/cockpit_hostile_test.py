"""Texts of the machine that look like markup or scripts, and the page's content security policy."""

import re
import urllib.request

from support import cockpit, machine
from support.cockpit import PageTest

MARKUP = '<img src=x onerror="window.ran=1"><b>bold</b>'
SCRIPT = '<script>window.ran=1</script>'
GROUP = '<b>crew</b>'
CONTROLS = 'bell \a escape \x1b[31m back \b\b end \u202etxt.exe'


class Hostile(PageTest):
    @classmethod
    def prepare(cls):
        machine.lay()
        passwd = machine.read('/etc/passwd').replace('Anna,,,', MARKUP).replace('Ben', SCRIPT)
        machine.write('/etc/passwd', passwd)
        with open('/etc/group', 'a') as groups:
            groups.write(f'{GROUP}:x:1600:carl\n')
        machine.write('/usr/sbin/modinfo', f"#!/bin/sh\necho 'version:        {MARKUP}'\n", 0o755)
        machine.write('/var/log/messages', machine.log_lines([MARKUP, SCRIPT, CONTROLS]))

    def setUp(self):
        self.browser.open()
        self.browser.see('#tree', 'anna')

    def assert_only_text(self):
        self.assertIsNone(self.browser.run('return window.ran'))
        self.assertEqual(self.browser.find('img, b, body script'), [])
        self.assertEqual(self.browser.refused(), [])
        self.assertEqual(self.browser.complaints(), [])

    def test_tree(self):
        self.browser.see('#tree', MARKUP, SCRIPT, GROUP)
        self.browser.click('#tree [data-address="user:anna"]')
        self.browser.see('#detail', MARKUP)
        self.browser.click('#tree [data-address=log] .mi-tree__toggle')
        self.browser.click('#tree [data-address="log:2"]')
        self.browser.see('#detail', SCRIPT)
        self.assert_only_text()

    def test_users_and_an_account(self):
        self.browser.click('#tab-users')
        self.browser.see('#users-table', MARKUP, SCRIPT)
        self.browser.button('anna', '#users-table')
        self.browser.see('#account', MARKUP)
        self.assert_only_text()

    def test_groups(self):
        self.browser.click('#tab-groups')
        self.browser.button(GROUP, '#groups-table')
        self.browser.see('#group', GROUP, '1600', 'carl')
        self.assert_only_text()

    def test_drivers(self):
        self.browser.click('#tab-drivers')
        self.browser.see('#drivers-table', MARKUP)
        self.assert_only_text()

    def test_log(self):
        self.browser.click('#tab-log')
        self.browser.see('#log-lines', MARKUP, SCRIPT, 'bell')
        self.browser.type('#log-filter', '<script>')
        self.browser.see('#log-lines', SCRIPT)
        self.browser.not_seen('#log-lines', 'bell')
        self.assert_only_text()

    def test_preview_of_a_change(self):
        self.browser.click('#tab-users')
        self.browser.button('ben', '#users-table')
        self.browser.click('#user-shell')
        self.browser.type('#field-shell', '/bin/sh')
        self.browser.click('#preview-run')
        self.browser.see('#preview .mi-added', SCRIPT)
        self.assert_only_text()

    def test_control_characters_are_made_visible(self):
        self.browser.click('#tree [data-address=log] .mi-tree__toggle')
        self.browser.see('#tree', 'bell')
        shown = self.browser.run('return document.getElementById("tree").textContent')
        self.assertNotRegex(shown, '[\x00-\x1f\x7f\u202e]')
        self.assert_only_text()

    def test_typed_text_is_not_markup_either(self):
        self.browser.type('#tree-search', MARKUP)
        self.browser.see('#tree', 'anna')
        self.browser.not_seen('#tree', 'carl')
        self.assert_only_text()


class Policy(PageTest):
    def test_forbids_inline_code_and_other_origins(self):
        with urllib.request.urlopen(f'{cockpit.ADDRESS}/cockpit/@localhost/mihost/index.html') as answer:
            policy = answer.headers['Content-Security-Policy']
            content = answer.read().decode()
        rules = dict(rule.strip().partition(' ')[::2] for rule in policy.split(';') if rule.strip())
        self.assertNotIn('unsafe', policy)
        self.assertNotIn('*', policy)
        self.assertIn("'none'", rules['default-src'])
        self.assertEqual(rules['script-src'].split()[0], "'self'")
        self.assertEqual(re.findall(r'<script>|<style|style=|\son\w+=|https?:', content), [])

    def test_browser_refuses_inline_code(self):
        """So the other tests would see a violation."""
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
