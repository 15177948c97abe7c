"""The collection's modules on a machine, by the real Ansible over real ssh."""

import unittest

from support import environment
from support.ansible import Controller, task

SETUP = '''
printf '#!/bin/sh\\nexec mihost --plugin /none "$@"\\n' >/usr/local/bin/without-plugin
chmod +x /usr/local/bin/without-plugin
'''

HASH = '$6$salt$Zbh6hqLzTNmnpS4zqjOyP3KgCOqn7aWGzYuMLRxv7PXDBHYgDd4BHYqPQH4dBnTUlSvQdQ8sR1yGqSgWgN1Hf/'


class Modules(unittest.TestCase):
    @classmethod
    def setUpClass(cls):
        cls.controller = Controller()
        cls.addClassCleanup(cls.controller.stop)
        cls.controller.link_collection()
        cls.machine = cls.controller.start('one', SETUP)

    def play(self, *tasks, options=()):
        """Returns the results on the one machine."""
        return self.controller.play(list(tasks), *options)['one']

    def record(self, file, name):
        """Returns the fields of an account's or a group's line."""
        return self.machine.run(f"grep '^{name}:' {file}").strip().split(':')


class Info(Modules):
    def test_returns_native_types_by_name(self):
        mi = self.play(task('mi_info'))[0]['mi']
        self.assertEqual(set(mi), {'computer', 'os', 'users', 'groups'} | set(mi) & {'drivers', 'log'})
        anna = mi['users']['anna']
        self.assertEqual(anna['user_id'], '1000')
        self.assertEqual(anna['password_max_days'], 90)
        self.assertIs(anna['delete'], False)
        self.assertEqual(mi['groups']['team']['members'], ['anna', 'ben', 'carl'])
        self.assertEqual(mi['groups']['team']['group_id'], 1500)

    def test_never_returns_password_hashes(self):
        self.assertIsNone(self.play(task('mi_info'))[0]['mi']['users']['anna']['password'])
        self.assertNotIn('$6$anna', self.controller.output)

    def test_returns_one_kind(self):
        users, system = self.play(task('mi_info', kind='users'), task('mi_info', kind='os'))
        self.assertEqual(list(users['mi']), ['users'])
        self.assertEqual(set(users['mi']['users']), {'root', 'anna', 'ben', 'carl'})
        self.assertEqual(list(system['mi']), ['os'])
        self.assertGreater(system['mi']['os']['physical_memory_size'], 0)
        self.assertNotIn('ansible_facts', users)

    def test_fills_the_facts_on_request(self):
        shown = {'ansible.builtin.debug': {'msg': '{{ ansible_facts.mi.users.anna.login_shell }}'}}
        info, shown = self.play(task('mi_info', facts=True), shown)
        self.assertEqual(shown['msg'], '/bin/bash')
        self.assertNotIn('mi', info)  # which would double what is sent


class CallAndSet(Modules):
    def test_call_changes_the_machine(self):
        result = self.play(task('mi_call', method='LocalGroupAdd', parameters={'GroupName': 'built'}))[0]
        self.assertTrue(result['changed'])
        self.assertEqual(self.record('/etc/group', 'built')[0], 'built')
        self.assertIn('/etc/group', [change['file'] for change in result['changes']])

    def test_check_mode_runs_in_a_sandbox(self):
        shell = {'UserName': 'anna', 'ScriptPath': '/bin/sh'}
        result = self.play(task('mi_call', method='UserSetScriptPath', parameters=shell), options=['--check'])[0]
        self.assertTrue(result['changed'])
        self.assertEqual(result['commands'][0]['command'], '/usr/sbin/usermod -s /bin/sh anna 2>&1')
        self.assertEqual(self.record('/etc/passwd', 'anna')[6], '/bin/bash')

    def test_set_acts_on_the_machine(self):
        self.machine.run('echo line >/var/log/messages')
        without, confirmed = self.play(
            {**task('mi_set', node='os', property='clear-log', value=9), 'ignore_errors': True},
            task('mi_set', node='os', property='clear-log', value=9, confirm=True),
        )
        self.assertEqual((without['rc'], without['reason']), (2, 'refused'))
        self.assertTrue(confirmed['changed'])
        self.assertEqual(self.machine.run('cat /var/log/messages'), '')

    def test_set_in_memory_only_changes_nothing_and_warns(self):
        result = self.play(task('mi_set', node='user:anna', property='login-shell', value='/bin/sh'))[0]
        self.assertFalse(result['changed'])
        self.assertIn('login-shell changed in memory only', ' '.join(result['warnings']))

    def test_failure_has_the_tools_message(self):
        result = self.play(task('mi_call', method='UserAdd', parameters={'UserName': 'anna'}))[0]
        self.assertEqual((result['outcome'], result['rc'], result['reason']), ('failed', 1, 'failed'))
        self.assertIn("useradd: user 'anna' already exists", result['msg'])

    def test_exit_codes_become_reasons(self):
        tasks = [
            task('mi_call', method='UserAdd', parameters={'UserName': 'x;reboot'}),
            task('mi_call', method='UserAdd', parameters={'UserName': 'x\nrefresh'}),
            task('mi_call', method='NoSuchMethod'),
            task('mi_set', node='user:nobody-here', property='delete', value='true'),
            task('mi_info', mihost='without-plugin'),
            task('mi_info', mihost='no-such-program'),
        ]
        results = self.play(*[{**each, 'ignore_errors': True} for each in tasks])
        self.assertEqual([result['outcome'] for result in results], ['failed'] * 6)
        self.assertEqual([result.get('rc') for result in results], [2, 2, 2, 4, 3, None])
        self.assertIn("';'", results[0]['msg'])
        self.assertIn('line break', results[1]['msg'])
        self.assertEqual(results[4]['reason'], 'no plug-in')
        self.assertIn('no-such-program', results[5]['msg'])

    def test_words_with_a_dash_are_never_options(self):
        result = self.play(task('mi_set', node='--yes', property='clear-log', value='9'))[0]
        self.assertEqual(result['rc'], 4)

    def test_passwords_are_shown_nowhere(self):
        parameters = {'UserName': 'ben'}
        result = self.play(
            task('mi_call', method='UserSetPassword', parameters=parameters, password='xkcd-936-secret'),
            options=['-vvv'],
        )[0]
        self.assertTrue(result['changed'], result)
        self.assertNotEqual(self.record('/etc/shadow', 'ben')[1], '$6$ben$hash')
        self.assertNotIn('xkcd-936-secret', self.controller.output)
        self.assertNotIn('xkcd-936-secret', self.machine.log())

    def test_secrets_are_accepted_only_in_their_options(self):
        results = self.play(
            {**task('mi_call', method='UserSetPassword', parameters={'UserName': 'ben', 'Password': 'x'}),
             'ignore_errors': True},
            *({**task('mi_set', node='user:ben', property=name, value=HASH), 'ignore_errors': True}
              for name in ('password', '117', '0117')),
            task('mi_set', node='user:ben', property='password', secret=HASH),
        )
        self.assertIn('option password', results[0]['msg'])
        for result in results[1:4]:
            self.assertIn('option secret', result['msg'])
        self.assertTrue(results[4]['changed'])
        self.assertEqual(self.record('/etc/shadow', 'ben')[1], HASH)


class User(Modules):
    FULL = dict(
        name='jdoe', full_name='J. Doe', home='/home/doe', shell='/bin/bash', password=HASH,
        password_min_days=1, password_max_days=60, password_warn_days=9, inactive_days=5,
        expires='2030-12-31',
    )

    def test_adds_changes_and_deletes_only_once(self):
        adapted = dict(
            self.FULL, full_name='Jane Doe', home='/home/jane', shell='/bin/sh', password='!',
            password_max_days=90, expires='2031-01-02',
        )
        gone = dict(name='jdoe', state='absent')
        results = self.play(
            task('mi_user', **self.FULL), task('mi_user', **self.FULL),
            {'ansible.builtin.command': 'grep -h ^jdoe: /etc/passwd /etc/shadow'},
            task('mi_user', **adapted), task('mi_user', **adapted),
            {'ansible.builtin.command': 'grep -h ^jdoe: /etc/passwd /etc/shadow'},
            task('mi_user', **gone), task('mi_user', **gone),
        )
        made, same, record, other, same_other, other_record, deleted, same_deleted = results
        self.assertEqual([result['outcome'] for result in results], ['ok'] * 8, results)
        self.assertEqual([each['changed'] for each in (made, other, deleted)], [True] * 3)
        self.assertEqual([each['changed'] for each in (same, same_other, same_deleted)], [False] * 3)

        account, ageing = (line.split(':') for line in record['stdout_lines'])
        self.assertEqual(account[4:], ['J. Doe', '/home/doe', '/bin/bash'])
        self.assertEqual([ageing[1]] + ageing[3:], [HASH, '1', '60', '9', '5', '22279', ''])
        account, ageing = (line.split(':') for line in other_record['stdout_lines'])
        self.assertEqual(account[4:], ['Jane Doe', '/home/jane', '/bin/sh'])
        self.assertEqual([ageing[1]] + ageing[3:], ['!', '1', '90', '9', '5', '22281', ''])
        self.assertEqual(self.machine.run('ls -d /home/jane').strip(), '/home/jane')

    def test_omitted_options_change_nothing(self):
        before = self.record('/etc/shadow', 'carl')
        result = self.play(task('mi_user', name='carl', password_max_days=80))[0]
        self.assertTrue(result['changed'])
        before[4] = '80'
        self.assertEqual(self.record('/etc/shadow', 'carl'), before)
        self.assertNotIn('warnings', result)

    def test_expires_never_removes_the_expiry_once(self):
        never = task('mi_user', name='anna', expires='never')
        first, second = self.play(never, never)
        self.assertEqual((first['changed'], second['changed']), (True, False))
        self.assertEqual(self.record('/etc/shadow', 'anna')[7], '')

    def test_days_are_the_same_in_every_time_zone(self):
        for zone in ('Pacific/Auckland', 'America/Los_Angeles'):
            result = self.controller.play(
                [{**task('mi_user', name='ben', expires='2011-01-26'), 'environment': {'TZ': zone}}]
            )['one'][0]
            self.assertFalse(result['changed'], zone)

    def test_system_accounts_are_refused(self):
        results = self.play(
            {**task('mi_user', name='daemon', state='absent'), 'ignore_errors': True},
            {**task('mi_user', name='daemon', shell='/bin/sh'), 'ignore_errors': True},
        )
        self.assertEqual([result['reason'] for result in results], ['refused'] * 2)
        self.assertEqual(self.record('/etc/passwd', 'daemon')[6], '/usr/sbin/nologin')

    def test_failure_says_whether_something_changed(self):
        result = self.play(task('mi_user', name='ben', shell='/bin/sh', full_name='a;b'))[0]
        self.assertEqual((result['outcome'], result['reason']), ('failed', 'refused'))
        self.assertFalse(result['changed'])
        result = self.play(task('mi_user', name='ben', full_name='Benjamin', shell='none'))[0]
        self.assertEqual((result['outcome'], result['changed']), ('failed', True))
        self.assertEqual(self.record('/etc/passwd', 'ben')[4], 'Benjamin')

    def test_a_bad_day_is_refused(self):
        results = self.play(
            {**task('mi_user', name='carl', expires='31.12.2030'), 'ignore_errors': True},
            {**task('mi_user', name='carl', expires='2030-02-30'), 'ignore_errors': True},
        )
        self.assertEqual([result['reason'] for result in results], ['refused'] * 2)


class Group(Modules):
    def test_adds_changes_and_deletes_only_once(self):
        steps = [
            dict(name='crew', members=['anna', 'ben']),
            dict(name='crew', members=['carl'], append=True),
            dict(name='crew', members=['carl']),
            dict(name='crew'),
            dict(name='crew', members=[]),
            dict(name='crew', state='absent'),
        ]
        tasks = []
        for step in steps:
            tasks += [task('mi_group', **step)] * 2
            tasks.append({'ansible.builtin.shell': 'grep ^crew: /etc/group || true'})
        results = self.play(*tasks)
        self.assertEqual([result['outcome'] for result in results], ['ok'] * len(tasks), results)
        self.assertEqual([each['changed'] for each in results[0::3]], [True, True, True, False, True, True])
        self.assertEqual([each['changed'] for each in results[1::3]], [False] * len(steps))
        members = [each['stdout'].rpartition(':')[2] for each in results[2::3]]
        self.assertEqual(members, ['anna,ben', 'anna,ben,carl', 'carl', 'carl', '', ''])

    def test_primary_members_are_kept(self):
        result = self.play(task('mi_group', name='anna', members=[]))[0]
        self.assertEqual((result['outcome'], result['changed']), ('ok', False))

    def test_system_groups_are_refused(self):
        result = self.play(task('mi_group', name='daemon', state='absent'))[0]
        self.assertEqual(result['reason'], 'refused')


if __name__ == '__main__':
    environment.main('ansible-playbook', 'ssh', 'ssh-keygen', environment.SSHD)
