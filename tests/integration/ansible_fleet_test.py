"""Three machines: a change is previewed, made, and made again; one of them fails."""

import unittest

from support import environment
from support.ansible import Controller, task

# On this machine three accounts have all the UIDs that may be given.
FULL = "sed -i 's/^UID_MAX.*/UID_MAX 1002/' /etc/login.defs"


class Fleet(unittest.TestCase):
    @classmethod
    def setUpClass(cls):
        cls.controller = Controller()
        cls.addClassCleanup(cls.controller.stop)
        cls.controller.link_collection()
        cls.machines = [
            cls.controller.start('one'),
            cls.controller.start('two'),
            cls.controller.start('three', FULL),
        ]

    def outcomes(self, results):
        return {host: (each[-1]['outcome'], each[-1].get('changed', False)) for host, each in results.items()}

    def accounts(self, name):
        """Returns the machines that have the account."""
        command = f'grep -c ^{name}: /etc/passwd || true'
        return [machine.name for machine in self.machines if machine.run(command) == '1\n']

    def test_previews_a_change_and_makes_it_once(self):
        change = [task('mi_user', name='jdoe', full_name='J. Doe', shell='/bin/bash')]
        expected = {'one': ('ok', True), 'two': ('ok', True), 'three': ('failed', False)}

        preview = self.controller.play(change, '--check', '--diff')
        self.assertEqual(self.outcomes(preview), expected)
        self.assertEqual(self.accounts('jdoe'), [])
        diff = {each['after_header']: each for each in preview['one'][0]['diff']}
        self.assertEqual(diff['/etc/passwd']['after'], 'jdoe:x:1003:100:J. Doe:/home/jdoe:/bin/bash\n')
        self.assertEqual(diff['/etc/passwd']['before'], '')
        self.assertNotIn('/etc/passwd-', diff)

        applied = self.controller.play(change, '--diff')
        self.assertEqual(self.outcomes(applied), expected)
        self.assertEqual(self.accounts('jdoe'), ['one', 'two'])
        account = self.machines[0].run('grep ^jdoe: /etc/passwd')
        self.assertEqual(account, diff['/etc/passwd']['after'])
        self.assertEqual(preview['three'][0]['msg'], applied['three'][0]['msg'])
        self.assertIn('no more available UIDs', preview['three'][0]['msg'])

        again = self.controller.play(change)
        self.assertEqual(self.outcomes(again), {**expected, 'one': ('ok', False), 'two': ('ok', False)})

    def test_each_task_takes_one_round_trip(self):
        tasks = [
            task('mi_info'),
            task('mi_group', name='crew', members=['anna']),
            task('mi_user', name='anna', shell='/bin/sh', full_name='Anna'),
        ]
        before = [machine.round_trips() for machine in self.machines]
        self.controller.play(tasks)
        after = [machine.round_trips() for machine in self.machines]
        self.assertEqual([end - start for start, end in zip(before, after)], [len(tasks)] * 3)


if __name__ == '__main__':
    environment.main('ansible-playbook', 'ssh', 'ssh-keygen', environment.SSHD)
