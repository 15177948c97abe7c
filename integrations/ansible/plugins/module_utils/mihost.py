"""Runs mihost, and converts its exit status to the outcome of a module."""

from __future__ import absolute_import, division, print_function

__metaclass__ = type

import json
import re

from ansible.module_utils.six.moves import shlex_quote
from ansible_collections.mi.host.plugins.module_utils.changes import diff_of
from ansible_collections.mi.host.plugins.module_utils.space import obstacle

REASONS = {
    1: 'failed',
    2: 'refused',
    3: 'no plug-in',
    4: 'not found',
}

READ_OPTIONS = dict(
    mihost=dict(type='str', default='mihost'),
)

CHANGE_OPTIONS = dict(
    READ_OPTIONS,
    lock_timeout=dict(type='int'),
)


def script_line(words, confirmed=False):
    """One command of 'mihost shell': a word that begins with a dash is never an option."""
    quoted = [shlex_quote(word) for word in words[1:]]
    return ' '.join((['--yes'] if confirmed else []) + [words[0], '--'] + quoted)


def without_place(message):
    """The message without 'mihost: ' and the line number of the script, which the user does not see."""
    return re.sub(r'^(mihost: )?(line \d+: )?', '', message)


class Mihost(object):
    """The program on the target."""

    def __init__(self, module):
        self.module = module
        self.program = module.get_bin_path(module.params['mihost'], required=True)

    def read(self, *words):
        """The JSON document printed by a command that reads."""
        code, output, errors = self._run(words)
        if code != 0:
            self._fail(code, errors)
        for line in errors.splitlines():
            self.module.warn(without_place(line))
        return json.loads(output)

    def find(self, address):
        """The node, with its secrets; None if there is none."""
        code, output, errors = self._run(['--show-secrets', 'get', '--', address])
        if code == 4:
            return None
        if code != 0:
            self._fail(code, errors)
        return json.loads(output)

    def change(self, lines):
        """Runs all commands on one loaded plug-in, in check mode within one sandbox.

        Returns the module's result.
        """
        if not lines:
            return self._outcome([])
        check = self.module.check_mode
        words = ['--sandbox'] if check else []
        if self.module.params['lock_timeout'] is not None:
            words += ['--lock-timeout', str(self.module.params['lock_timeout'])]
        for line in lines:
            if '\n' in line:
                self.module.fail_json(msg='a value contains a line break', rc=2, reason=REASONS[2])
        code, output, errors = self._run(words + ['shell'], '\n'.join(lines))
        result = self._outcome([json.loads(line) for line in output.splitlines()])
        if code != 0 and check:
            result['changed'] = False  # the sandbox is discarded
        if code != 0:
            self._fail(code, errors, **result)
        if check:
            problem = obstacle(result['changes'])
            if problem:
                self._fail(1, problem, **dict(result, changed=False))
        return result

    def _run(self, words, script=None):
        return self.module.run_command([self.program, '--json'] + list(words), data=script)

    def _outcome(self, reports):
        def joined(key):
            return [item for report in reports for item in report.get(key, [])]

        changes = joined('changes')
        result = dict(
            changed=any(report.get('changed', False) for report in reports),
            changes=changes,
        )
        if self.module.check_mode:
            result['commands'] = joined('commands')
        if self.module._diff:
            result['diff'] = diff_of(changes)
        for warning in joined('warnings'):
            self.module.warn(warning)
        return result

    def _fail(self, code, errors, **result):
        lines = errors.strip().splitlines()
        message = without_place(lines[-1]) if lines else 'mihost ended with %d' % code
        self.module.fail_json(msg=message, rc=code, reason=REASONS.get(code, 'failed'), **result)
