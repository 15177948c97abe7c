"""Changes from the page: the preview, the change itself, and the questions before it."""

import socket
import subprocess

from support import cockpit, machine
from support.browser import Keys
from support.cockpit import PageTest

CARL = 'carl:x:1002:100:Carl Example:/home/carl:/bin/sh'
CARL_WITH_BASH = 'carl:x:1002:100:Carl Example:/home/carl:/bin/bash'
PASSWORD = 'Correct-Horse9'


class ChangeTest(PageTest):
    def setUp(self):
        machine.lay()

    def open_account(self, name):
        self.browser.open('users')
        self.browser.button(name, '#users-table')
        self.browser.see('#account', f'/home/{name}')

    def fill(self, **fields):
        for name, text in fields.items():
            self.browser.type(f'#field-{name}', text)

    def preview(self):
        self.browser.click('#preview-run')
        self.browser.see('#preview', 'Commands that would run')

    def apply(self):
        """Applies the change and waits until the dialog closes; if something fails it stays open."""
        self.browser.click('#preview-apply')
        self.browser.gone('#preview')
        self.browser.see('#notice', 'Done: ')

    def changes(self):
        """Returns the calls that changed the machine itself."""
        return [call for call in cockpit.calls() if '--yes' in call and '--sandbox' not in call]

    def assert_unchanged(self, *names):
        for name in names:
            self.assertEqual(machine.read(f'/etc/{name}'), machine.read(f'{machine.MACHINE}/etc/{name}'), name)
        self.assertEqual(self.changes(), [])

    def can_apply(self):
        return self.browser.find('#preview-apply')[0].is_enabled()


class Accounts(ChangeTest):
    def start_shell_change(self):
        self.open_account('carl')
        self.browser.click('#user-shell')
        self.fill(shell='/bin/bash')

    def test_preview_shows_commands_and_lines_and_changes_nothing(self):
        self.start_shell_change()
        self.assertFalse(self.can_apply())
        self.preview()
        shown = [self.browser.text(f'#preview .mi-{each}').strip() for each in ('command', 'removed', 'added')]
        self.assertEqual(
            shown, ['$ /usr/sbin/usermod -s /bin/bash carl 2>&1', f'- {CARL}', f'+ {CARL_WITH_BASH}']
        )
        self.browser.see('#preview', '/etc/passwd')
        self.assert_unchanged('passwd', 'shadow', 'group')
        self.assertTrue(self.can_apply())

    def test_applies_what_was_previewed(self):
        self.start_shell_change()
        self.preview()
        self.apply()
        self.assertEqual(machine.accounts_file('passwd')['carl'], CARL_WITH_BASH)
        self.assertEqual(self.changes(), ['--json --yes user set-shell -- carl /bin/bash'])
        self.browser.see('#account', '/bin/bash')

    def test_cancels(self):
        self.start_shell_change()
        self.preview()
        self.browser.click('#preview-cancel')
        self.browser.gone('#preview')
        self.assert_unchanged('passwd', 'shadow', 'group')

    def test_a_later_edit_needs_a_new_preview(self):
        self.start_shell_change()
        self.preview()
        self.fill(shell='/bin/dash')
        self.assertFalse(self.can_apply())
        self.preview()
        self.browser.see('#preview .mi-added', '/bin/dash')
        self.assertTrue(self.can_apply())

    def test_shows_why_mihost_refuses(self):
        self.start_shell_change()
        self.fill(shell='/bin/sh; reboot')
        self.browser.click('#preview-run')
        self.browser.see('#preview', 'This would fail', "contains the shell metacharacter ';'")
        self.assertFalse(self.can_apply())
        self.assert_unchanged('passwd', 'shadow', 'group')

    def test_cannot_apply_if_mihost_is_killed_in_the_preview(self):
        cockpit.install_mihost(cockpit.DIES_IN_PREVIEW)
        self.addCleanup(cockpit.install_mihost)
        self.start_shell_change()
        self.browser.click('#preview-run')
        self.browser.see('#preview', 'stopped before it had answered')
        self.assertFalse(self.can_apply())
        self.assert_unchanged('passwd', 'shadow', 'group')

    def test_changes_with_only_the_keyboard(self):
        self.browser.open('users')
        self.browser.see('#users-table', 'carl')
        self.browser.tab_to('#users-table tr[data-name=carl] button')
        self.browser.press(Keys.ENTER)
        self.browser.see('#account', '/home/carl')
        self.browser.tab_to('#user-shell')
        self.browser.press(Keys.ENTER)
        self.browser.wait('return document.activeElement.id === "field-shell"')  # the field that is typed into
        self.browser.press(Keys.CONTROL, 'a')
        self.browser.press('/bin/bash', Keys.ENTER)
        self.browser.see('#preview', 'Commands that would run')
        self.browser.tab_to('#preview-apply')
        self.browser.press(Keys.ENTER)
        self.browser.see('#notice', 'Done: ')
        self.assertEqual(machine.accounts_file('passwd')['carl'], CARL_WITH_BASH)

    def test_escape_cancels(self):
        self.start_shell_change()
        self.preview()
        self.browser.press(Keys.ESCAPE)
        self.browser.gone('#preview')
        self.assert_unchanged('passwd', 'shadow', 'group')

    def test_expires_an_account(self):
        self.open_account('carl')
        self.browser.click('#user-expiry')
        self.browser.act('#field-expires', lambda field: field.send_keys('02032031'))  # as it is typed in English
        self.preview()
        self.apply()
        self.assertEqual(machine.accounts_file('shadow')['carl'].split(':')[7], '22313')  # that day, since 1970

    def test_changes_ageing(self):
        self.open_account('carl')
        self.browser.click('#user-ageing')
        self.browser.see('#preview', 'Change password ageing')
        for name, days in (('min', '1'), ('max', '90'), ('warn', '14'), ('inactive', '30')):
            self.assertEqual(self.browser.attributes(f'#field-{name}-days', 'value'), [days])
        self.fill(**{'max-days': '60', 'warn-days': '7'})
        self.preview()
        self.apply()
        self.assertEqual(machine.accounts_file('shadow')['carl'].split(':')[3:7], ['1', '60', '7', '30'])

    def test_adds_an_account_with_a_group(self):
        self.browser.open('users')
        self.browser.click('#user-add')
        self.browser.click('#preview-run')
        self.browser.see('#preview', 'Enter a value.')
        self.fill(**{'user': 'dora', 'full-name': 'Dora D', 'shell': '/bin/sh'})
        self.preview()
        self.assertNotIn('dora', machine.accounts_file('passwd'))
        self.apply()
        self.assertEqual(machine.accounts_file('passwd')['dora'], 'dora:x:1003:100:Dora D:/home/dora:/bin/sh')
        self.browser.button('dora', '#users-table')
        self.browser.click('#user-groups-add')
        self.fill(group='team')
        self.preview()
        self.apply()
        self.assertEqual(machine.accounts_file('group')['team'], 'team:x:1500:anna,ben,carl,dora')
        self.browser.see('#account', 'team')

    def test_deletes_only_if_the_name_is_typed(self):
        self.open_account('carl')
        self.browser.click('#user-delete')
        self.preview()
        self.browser.see('#preview', 'Type the name of the user')
        self.assertFalse(self.can_apply())
        self.browser.type('#confirm-name', 'car')
        self.assertFalse(self.can_apply())
        self.browser.press(Keys.ENTER)
        self.assert_unchanged('passwd', 'shadow', 'group')
        self.browser.type('#confirm-name', 'carl')
        self.apply()
        self.assertNotIn('carl', machine.accounts_file('passwd'))
        self.browser.see('#users-table', 'ben')
        self.browser.not_seen('#users-table', 'carl')


class Password(ChangeTest):
    def fill_in(self, again=PASSWORD):
        self.open_account('carl')
        self.browser.click('#user-password')
        self.fill(**{'password': PASSWORD, 'password-again': again})

    def test_is_set_and_shown_nowhere(self):
        self.fill_in()
        self.preview()
        self.assert_seen_nowhere()
        self.apply()
        self.assert_seen_nowhere()
        secret = machine.accounts_file('shadow')['carl'].split(':')[1]
        check = ['perl', '-e', 'print crypt($ARGV[0], $ARGV[1])', PASSWORD, secret]
        self.assertEqual(subprocess.run(check, capture_output=True, text=True).stdout, secret)

    def assert_seen_nowhere(self):
        """Neither as an argument of a process nor in the page, its address or its storage."""
        processes = machine.read(cockpit.PROCESSES)
        self.assertIn('cockpit-bridge', processes)
        self.assertIn('user set-password -- carl', '\n'.join(cockpit.calls()))
        for text in (
            processes, '\n'.join(cockpit.calls()), self.browser.driver.current_url,
            self.browser.run('return document.documentElement.outerHTML + document.body.innerText'),
            self.browser.run('return JSON.stringify({...localStorage, ...sessionStorage})'),
        ):
            self.assertNotIn(PASSWORD, text)

    def test_must_be_typed_twice(self):
        self.fill_in(again='something else')
        self.browser.click('#preview-run')
        self.browser.see('#preview', 'The passwords differ.')
        self.assertFalse(self.can_apply())

    def test_is_hidden_in_its_fields(self):
        self.fill_in()
        for name in ('password', 'password-again'):
            self.assertEqual(self.browser.find(f'#field-{name}')[0].get_attribute('type'), 'password')


class Machine(ChangeTest):
    def refuse_then_confirm(self):
        """Types another name than that of the machine, and then its own."""
        self.preview()
        self.browser.see('#preview', 'Type the name of this machine')
        self.assertFalse(self.can_apply())
        self.browser.type('#confirm-name', 'another')
        self.assertFalse(self.can_apply())
        self.assertEqual(self.changes(), [])
        self.browser.type('#confirm-name', socket.gethostname())
        self.apply()

    def test_clears_its_log_only_if_its_name_is_typed(self):
        self.browser.open('log')
        self.browser.see('#log-lines', 'three')
        self.browser.click('#log-clear')
        self.refuse_then_confirm()
        self.assertEqual(machine.read('/var/log/messages'), '')
        self.browser.not_seen('#log-lines', 'three')

    def test_restarts_only_if_its_name_is_typed(self):
        self.browser.open('host')
        self.browser.click('#host-restart')
        self.refuse_then_confirm()
        self.assertEqual(self.changes(), ['--json --yes power restart'])

    def test_halts_only_if_its_name_is_typed(self):
        self.browser.open('host')
        self.browser.click('#host-halt')
        self.refuse_then_confirm()
        self.assertEqual(self.changes(), ['--json --yes power halt'])


class Groups(ChangeTest):
    def test_adds_a_group_and_deletes_it(self):
        self.browser.open('groups')
        self.browser.click('#group-add')
        self.fill(group='crew')
        self.preview()
        self.apply()
        self.assertEqual(machine.accounts_file('group')['crew'], 'crew:x:1501:')
        self.browser.button('crew', '#groups-table')
        self.browser.click('#group-delete')
        self.preview()
        self.browser.type('#confirm-name', 'crew')
        self.apply()
        self.assertNotIn('crew', machine.accounts_file('group'))

    def test_removes_a_member(self):
        self.browser.open('groups')
        self.browser.button('team', '#groups-table')
        self.browser.button('Remove user ben', '#group')
        self.preview()
        self.apply()
        self.assertEqual(machine.accounts_file('group')['team'], 'team:x:1500:anna,carl')


class Unprivileged(ChangeTest):
    ACCOUNT = 'ben'

    def test_can_change_nothing_and_sees_why(self):
        self.browser.open('users')
        self.browser.see('#state', 'Limited access', 'nothing can be previewed or changed')
        self.browser.button('carl', '#users-table')
        self.browser.see('#account', '/home/carl')
        buttons = self.browser.find('[data-changes]')
        self.assertGreater(len(buttons), 5)
        self.assertEqual([each.text for each in buttons if each.is_enabled()], [])
        self.assertEqual(self.changes(), [])


def setUpModule():
    cockpit.install_cockpit()


if __name__ == '__main__':
    cockpit.main()
