"""What the page shows when mihost is missing, too old, slow, killed or prints something else."""

import os

from support import cockpit, environment, machine
from support.cockpit import PageTest

GO = '/run/go-on'

KILLED = '''#!/bin/sh
printf 'id,parent,kind,address,des'
kill -9 $$
'''
OLD = '''#!/bin/sh
echo mihost 0.0.9
'''
GARBLED = '''#!/bin/sh
[ "$1" != --version ] || exec echo mihost 9.9.9
echo '<html>Please log in</html>'
'''
NO_PLUGIN = f'''#!/bin/sh
exec {environment.MIHOST} --plugin /none/such.so "$@"
'''
SLOW = f'''#!/bin/sh
while [ ! -e {GO} ]; do sleep 0.1; done
exec {environment.MIHOST} "$@"
'''


class States(PageTest):
    def tearDown(self):
        cockpit.install_mihost()

    def state(self, name, *texts):
        self.browser.shown(f'#state [data-state={name}]')
        self.browser.see('#state', *texts)

    def try_again(self):
        """Installs a mihost that works and tries again."""
        cockpit.install_mihost()
        self.browser.button('Try again', '#state')
        self.browser.see('#tree', 'anna')

    def test_missing(self):
        os.unlink(cockpit.MIHOST)
        self.browser.open()
        self.state('missing', 'mihost is not installed')
        self.try_again()
        self.browser.gone('#state [data-state=missing]')

    def test_too_old(self):
        cockpit.install_mihost(OLD)
        self.browser.open()
        self.state('too-old', 'too old', 'mihost 0.0.9')

    def test_killed_while_the_page_is_read(self):
        cockpit.install_mihost(KILLED)
        self.browser.open()
        self.state('killed', 'was stopped before it had answered')
        self.assertEqual(self.browser.find('#tree [role=treeitem]'), [])
        self.try_again()
        self.browser.gone('#state [data-state=killed]')

    def test_killed_while_values_are_followed(self):
        self.browser.open()
        self.browser.see('#detail [data-property=process-count]', 'processes')
        cockpit.kill_mihost('watch')
        self.browser.see('body', 'was stopped')

    def test_prints_something_else(self):
        cockpit.install_mihost(GARBLED)
        self.browser.open()
        self.state('garbled', 'cannot read')

    def test_cannot_load_its_plugin(self):
        cockpit.install_mihost(NO_PLUGIN)
        self.browser.open()
        self.state('no-plugin', '/none/such.so')
        self.try_again()

    def test_slow(self):
        cockpit.install_mihost(SLOW)
        self.browser.open()
        self.state('slow', 'taking long')
        machine.write(GO, '')
        self.addCleanup(os.unlink, GO)
        self.browser.see('#tree', 'anna')
        self.browser.gone('#state [data-state=slow]')

    def test_slow_and_stopped(self):
        cockpit.install_mihost(SLOW)
        self.browser.open()
        self.state('slow')
        self.browser.button('Stop waiting', '#state')
        self.browser.see('#panel-tree', 'Reading was stopped')


class Unprivileged(PageTest):
    ACCOUNT = 'ben'

    def test_says_what_is_missing_and_shows_the_rest(self):
        self.browser.open()
        self.browser.see('#state', 'Limited access', 'ageing of accounts are unknown')
        self.browser.see('#tree', 'carl', 'team')
        self.browser.see('#detail', 'physical-memory-free')


def setUpModule():
    cockpit.install_cockpit()


if __name__ == '__main__':
    cockpit.main()
