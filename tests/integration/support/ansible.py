"""Runs the real Ansible without this machine's configuration, and leaves nothing on it."""

import json
import os
import subprocess
import tempfile

from support import environment, targets

COLLECTION = os.path.join(environment.SOURCE, 'integrations', 'ansible')
CALLBACKS = os.path.join(os.path.dirname(__file__), 'callbacks')


def task(module, **options):
    """Returns a task of a play, with a module of the collection."""
    return {f'mi.host.{module}': options}


class Controller:
    """A controller with its own home, collection and inventory."""

    def __init__(self):
        self.place = tempfile.TemporaryDirectory(prefix='mi-ansible-')
        self.folder = self.place.name
        self.hosts = []
        self.environment = {
            'HOME': self.folder,
            'PATH': '/usr/sbin:/usr/bin:/sbin:/bin',
            'LC_ALL': 'C.UTF-8',
            'ANSIBLE_HOME': self.path('ansible'),
            'ANSIBLE_CONFIG': self.path('ansible.cfg'),
            'ANSIBLE_COLLECTIONS_PATH': self.path('collections'),
            'ANSIBLE_CALLBACK_PLUGINS': CALLBACKS,
            'ANSIBLE_STDOUT_CALLBACK': 'lines',
            'ANSIBLE_HOST_KEY_CHECKING': 'False',
            'ANSIBLE_PIPELINING': 'True',
            'ANSIBLE_SSH_ARGS': '-F none -C -o ControlMaster=auto -o ControlPersist=60s',
            'ANSIBLE_NOCOLOR': '1',
            'PYTHONDONTWRITEBYTECODE': '1',
        }
        open(self.path('ansible.cfg'), 'w').close()
        targets.make_keys(self.folder)

    def path(self, *names):
        return os.path.join(self.folder, *names)

    def link_collection(self):
        """Uses the collection as it is in the repository."""
        os.makedirs(self.path('collections', 'ansible_collections', 'mi'))
        os.symlink(COLLECTION, self.path('collections', 'ansible_collections', 'mi', 'host'))

    def start(self, name, setup='true'):
        """Starts a machine and puts it into the inventory."""
        target = targets.Target(name, self.folder, setup)
        self.hosts.append(target)
        with open(self.path('hosts'), 'w') as inventory:
            for host in self.hosts:
                inventory.write(
                    f'{host.name} ansible_host=127.0.0.1 ansible_port={host.port} ansible_user=root'
                    f' ansible_ssh_private_key_file={host.key}'
                    ' ansible_python_interpreter=/usr/bin/python3\n'
                )
        return target

    def run(self, *command, **variables):
        """Runs a program of Ansible's to its end."""
        return subprocess.run(
            command, cwd=self.folder, env={**self.environment, **variables},
            stdin=subprocess.DEVNULL, capture_output=True, text=True,
        )

    def play(self, tasks, *options):
        """Returns the results of the tasks, keyed by host and in the order of the tasks."""
        book = [{'hosts': 'all', 'gather_facts': False, 'tasks': tasks}]
        with open(self.path('play.yml'), 'w') as file:
            json.dump(book, file)  # which is YAML, too
        done = self.run('ansible-playbook', '-i', self.path('hosts'), *options, self.path('play.yml'))
        results = {host.name: [] for host in self.hosts}
        for line in done.stdout.splitlines():
            if line.startswith('{'):
                entry = json.loads(line)
                results[entry['host']].append({**entry['result'], 'outcome': entry['outcome']})
        if not any(results.values()):
            raise RuntimeError(done.stdout + done.stderr)
        self.output = done.stdout + done.stderr
        return results

    def stop(self):
        for host in self.hosts:
            host.stop()
        self.place.cleanup()
