"""The page after a login to Cockpit: real accounts and passwords, the menu, the frame."""

import os
import shutil
import subprocess
import time

from support import cockpit, environment, machine

ACCOUNTS = ('root', 'anna', 'ben', 'carl')
PASSWORD = 'correct horse'


class Login(cockpit.PageTest):
    ACCOUNT = None

    @classmethod
    def prepare(cls):
        machine.lay()
        changed = int(time.time()) // 86400 - 20
        machine.write('/etc/shadow', ''.join(f'{name}:*:{changed}:0:90:14:30::\n' for name in ACCOUNTS), 0o600)
        shutil.copy(environment.daemon('/etc/pam.d/cockpit'), '/etc/pam.d/cockpit')
        # Newer versions leave the session of a login to systemd, unless there is a command.
        if os.path.exists(environment.daemon('/usr/lib/systemd/system/cockpit-session.socket')):
            session = environment.daemon('/usr/lib/cockpit/cockpit-session')
            machine.write('/etc/cockpit/cockpit.conf', f'[Basic]\nCommand = {session}\n')
        subprocess.run(['chpasswd'], input=f'root:{PASSWORD}\nanna:{PASSWORD}\n', text=True, check=True)

    def log_in(self, name):
        self.browser.leave()
        self.browser.load(cockpit.ADDRESS)
        self.browser.type('#login-user-input', name)
        self.browser.type('#login-password-input', PASSWORD)
        self.browser.click('#login-button')
        self.browser.button('Management tree')
        self.browser.enter('iframe[name="cockpit1:localhost/mihost"]')

    def test_root_finds_the_page_in_the_menu(self):
        self.log_in('root')
        self.browser.see('#tree', 'anna')

    def test_change_is_previewed_in_the_frame(self):
        self.log_in('root')
        self.browser.click('#tab-users')
        self.browser.button('carl', '#users-table')
        self.browser.click('#user-shell')
        self.browser.type('#field-shell', '/bin/zsh')
        self.browser.click('#preview-run')
        self.browser.see('#preview .mi-added', '/home/carl:/bin/zsh')
        self.browser.shown('#preview-apply:enabled')
        self.browser.picture('cockpit')  # see script/cockpit-picture

    def test_limited_access_is_shown(self):
        self.log_in('anna')
        self.browser.see('#tree', 'anna')
        self.browser.see('#state', 'Limited access')


def setUpModule():
    cockpit.install_cockpit()


if __name__ == '__main__':
    cockpit.main()
