"""Ten thousand users and a log of a million lines."""

from support import cockpit, machine
from support.cockpit import PageTest

USERS = 10000
LINES = 1000000


class Many(PageTest):
    @classmethod
    def prepare(cls):
        machine.lay()
        names = [f'user{number:05}' for number in range(USERS)]
        with open('/etc/passwd', 'a') as accounts:
            accounts.writelines(
                f'{name}:x:{2000 + number}:100:Number {number}:/home/{name}:/bin/sh\n'
                for number, name in enumerate(names)
            )
        with open('/etc/shadow', 'a') as secrets:
            secrets.writelines(f'{name}:!:14000:1:90:14:30:15000:\n' for name in names)
        with open('/var/log/messages', 'w') as log:
            for first in range(0, LINES, 1000):
                log.write(machine.log_lines(f'line {number}' for number in range(first, first + 1000)))

    def few(self, css):
        """Expects far fewer elements than there are users or lines."""
        self.assertLess(len(self.browser.find(css)), 200)

    def scroll(self, css, share):
        self.browser.run(
            'const e = document.querySelector(arguments[0]); e.scrollTop = e.scrollHeight * arguments[1]', css, share,
        )

    def test_tree_has_only_the_visible_rows(self):
        self.browser.open()
        self.browser.see('#tree', 'user00000')
        self.few('#tree [role=treeitem]')
        self.scroll('#tree', 0.5)
        self.browser.see('#tree', 'user04990')
        self.few('#tree [role=treeitem]')
        self.browser.type('#tree-search', 'user07777')
        self.browser.see('#tree', 'Number 7777')
        self.browser.not_seen('#tree', 'user04990')

    def test_users_have_only_the_visible_rows(self):
        self.browser.open('users')
        self.browser.see('#users-table', 'user00000')
        self.few('#users-table tr')
        for share in (0.25, 0.5, 0.75, 1):
            self.scroll('#panel-users .mi-scroller', share)
            self.few('#users-table tr')
        self.browser.see('#users-table', f'user{USERS - 1:05}')
        self.browser.type('#users-filter', 'number 7777')
        self.browser.see('#users-table', 'user07777')
        self.browser.not_seen('#users-table', f'user{USERS - 1:05}')

    def test_log_has_the_newest_lines(self):
        self.browser.open('log')
        self.browser.see('#log-lines', f'line {LINES - 1}')
        self.few('#log-lines *')


def setUpModule():
    cockpit.install_cockpit()


if __name__ == '__main__':
    cockpit.main()
