"""facts.py [ROUNDS]: the cost of the facts of three machines with mi_info, and with Ansible's own modules.

The machines are copies of this one, each with an sshd on loopback and 100 accounts.
"""

import json
import os
import resource
import sys
import time

sys.path.insert(0, os.path.join(os.environ['MI_SOURCE'], 'tests', 'integration'))
from measure import alternating, cell, table
from support.ansible import Controller, task

ACCOUNTS = '''
for id in $(seq 2000 2099); do
    echo "user$id:x:$id:100:User $id:/home/user$id:/bin/sh" >>/etc/passwd
    echo "user$id:!:19000:0:99999:7:::" >>/etc/shadow
    echo "group$id:x:$id:user$id" >>/etc/group
done
'''

GETENT = [{'ansible.builtin.getent': {'database': name}} for name in ('passwd', 'shadow', 'group')]

# The plays, each with the pattern of its machines.
PLAYS = {
    '`ping`, to compare': ('all', [{'ansible.builtin.ping': {}}]),
    '`mi_info`': ('all', [task('mi_info', facts=True)]),
    '`mi_info`, one machine': ('one', [task('mi_info', facts=True)]),
    '`setup`': ('all', [{'ansible.builtin.setup': {}}]),
    '`setup`, without network and hardware': ('all', [{'ansible.builtin.setup': {'gather_subset': '!all'}}]),
    '`setup` and `getent` of passwd, shadow, group': ('all', [{'ansible.builtin.setup': {}}, *GETENT]),
}


def main():
    rounds = int(sys.argv[1]) if len(sys.argv) > 1 else 7
    controller = Controller()
    try:
        controller.link_collection()
        machines = [controller.start(name, ACCOUNTS) for name in ('one', 'two', 'three')]

        def run(pattern, tasks):
            before = resource.getrusage(resource.RUSAGE_CHILDREN)
            trips = sum(machine.round_trips() for machine in machines)
            start = time.monotonic()
            results = controller.play(tasks, '--limit', pattern)
            seconds = time.monotonic() - start
            after = resource.getrusage(resource.RUSAGE_CHILDREN)
            reached = [result for result in results.values() if result]
            outcomes = {each['outcome'] for result in results.values() for each in result}
            if outcomes != {'ok'}:
                raise RuntimeError(controller.output)
            return dict(
                seconds=seconds,
                processor=after.ru_utime + after.ru_stime - before.ru_utime - before.ru_stime,
                trips=(sum(machine.round_trips() for machine in machines) - trips) / len(reached),
                size=len(json.dumps(results['one'])) / 1000,
            )

        run(*PLAYS['`ping`, to compare'])  # opens the connections
        results = alternating({name: lambda play=play: run(*play) for name, play in PLAYS.items()}, rounds)
    finally:
        controller.stop()
    rows = [
        [name, cell([each['seconds'] for each in runs]), cell([each['processor'] for each in runs]),
         f'{runs[0]["trips"]:.0f}', f'{runs[0]["size"]:.0f}']
        for name, runs in results.items()
    ]
    print(table(['Play', 'Time, s', 'Processor time of the controller, s',
                 'Round trips per machine', 'Results of a machine, kB'], rows))


main()
