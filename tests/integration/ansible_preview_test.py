"""Check mode on machines where the change would fail: it fails too, and changes nothing."""

import unittest

from support import environment
from support.ansible import Controller

# name, how the machine gets into that state, whether the account has a home directory, a part of the
# real error message, and of the predicted one
MACHINES = (
    (
        'ids-in-use',
        'sed -i "s/^UID_MAX.*/UID_MAX 1002/" /etc/login.defs',
        False,
        'no more available UIDs',
        'no more available UIDs',
    ),
    (
        'refusing-tool',
        "mv /usr/sbin/useradd /usr/sbin/useradd.real; printf '#!/bin/sh\\necho useradd: not today >&2; exit 1\\n'"
        ' >/usr/sbin/useradd; chmod +x /usr/sbin/useradd',
        False,
        'not today',
        'not today',
    ),
    (
        'full-disk',
        'cp -a /etc /run/etc; mount -t tmpfs -o size=32m tmpfs /etc; cp -a /run/etc/. /etc;'
        ' cat /dev/zero >/etc/full 2>/dev/null || true',
        False,
        'useradd: ',
        'no space left for /etc/',
    ),
    (
        'no-inodes',
        'mkdir -p /home; mount -t tmpfs -o nr_inodes=1 tmpfs /home',
        True,
        'cannot create directory /home/jdoe',
        'no space left for /home/jdoe',
    ),
    (
        'read-only',
        'mkdir -p /home; mount -t tmpfs -o ro tmpfs /home',
        True,
        'cannot create directory /home/jdoe',
        'the file system of /home/jdoe is read-only',
    ),
)


class Preview(unittest.TestCase):
    @classmethod
    def setUpClass(cls):
        cls.controller = Controller()
        cls.addClassCleanup(cls.controller.stop)
        cls.controller.link_collection()
        cls.machines = {row[0]: cls.controller.start(row[0], row[1]) for row in MACHINES}

    def results(self, module, name, *options):
        """Adds an account of that name on each machine and returns the results."""
        accounts = {
            row[0]: dict(name=name, **(dict(home=f'/home/{name}') if row[2] else {}))
            for row in MACHINES
        }
        play = [{module: '{{ accounts[inventory_hostname] }}', 'vars': {'accounts': accounts}}]
        return {host: each[0] for host, each in self.controller.play(play, *options).items()}

    def test_every_failure_is_predicted(self):
        preview = self.results('mi.host.mi_user', 'jdoe', '--check')
        for machine in self.machines.values():
            self.assertEqual(machine.run('grep ^jdoe: /etc/passwd || true'), '')
        real = self.results('mi.host.mi_user', 'jdoe')
        for name, _, _, really, predicted in MACHINES:
            with self.subTest(name):
                self.assertEqual((preview[name]['outcome'], preview[name]['changed']), ('failed', False))
                self.assertIn(predicted, preview[name]['msg'])
                self.assertEqual(real[name]['outcome'], 'failed')
                self.assertIn(really, real[name]['msg'])

    def test_the_built_in_module_predicts_none_of_them(self):
        preview = self.results('ansible.builtin.user', 'kim', '--check')
        real = self.results('ansible.builtin.user', 'kim')
        for name in self.machines:
            with self.subTest(name):
                self.assertEqual((preview[name]['outcome'], preview[name]['changed']), ('ok', True))
                self.assertEqual(real[name]['outcome'], 'failed')


if __name__ == '__main__':
    environment.main('ansible-playbook', 'ssh', 'ssh-keygen', environment.SSHD)
