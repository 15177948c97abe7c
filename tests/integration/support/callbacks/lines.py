"""Prints the result of each task on each host as a line of JSON."""

import json

from ansible.plugins.callback import CallbackBase

DOCUMENTATION = '''
name: lines
type: stdout
short_description: one line of JSON for each result
description: Prints the result of each task on each host as a line of JSON.
'''


class CallbackModule(CallbackBase):
    CALLBACK_VERSION = 2.0
    CALLBACK_TYPE = 'stdout'
    CALLBACK_NAME = 'lines'

    def _write(self, outcome, result):
        shown = json.loads(self._dump_results(result._result))
        # Which _dump_results drops, the warnings since ansible-core 2.19, where they are objects.
        if 'diff' in result._result:
            shown['diff'] = result._result['diff']
        if 'warnings' in result._result:
            shown['warnings'] = [str(warning) for warning in result._result['warnings']]
        line = dict(host=result._host.get_name(), outcome=outcome, result=shown)
        self._display.display(json.dumps(line))

    def v2_runner_on_ok(self, result):
        self._write('ok', result)

    def v2_runner_on_failed(self, result, ignore_errors=False):
        self._write('failed', result)

    def v2_runner_on_unreachable(self, result):
        self._write('unreachable', result)
