"""Machines to administer: each is a copy of this one in its own sandbox, with a real sshd."""

import os
import socket
import subprocess
import sys

from support import environment
from support.machine import MACHINE

SCRIPT = os.path.join(os.path.dirname(__file__), 'target.py')


def make_keys(folder):
    """Makes the keys of the hosts and of the user who logs in."""
    for name in ('host', 'user'):
        subprocess.run(
            ['ssh-keygen', '-q', '-t', 'ed25519', '-N', '', '-f', os.path.join(folder, name)],
            check=True,
        )


class Target:
    """One machine; its port is on the loopback interface of this one."""

    def __init__(self, name, folder, setup='true'):
        self.name = name
        self.log_path = os.path.join(folder, name + '.log')
        listener = socket.create_server(('127.0.0.1', 0))
        self.port = listener.getsockname()[1]
        self.key = os.path.join(folder, 'user')
        command = [
            environment.SANDBOXED, sys.executable, SCRIPT, MACHINE, environment.MIHOST,
            environment.SSHD, str(listener.fileno()), folder, setup,
        ]
        with open(self.log_path, 'w') as log:
            self.process = subprocess.Popen(
                command, stdin=subprocess.DEVNULL, stdout=subprocess.PIPE, stderr=log,
                text=True, pass_fds=[listener.fileno()],
            )
        listener.close()
        if self.process.stdout.readline() != 'ready\n':
            self.process.wait()
            raise RuntimeError(f'{name} does not start: {self.log()}')

    def log(self):
        with open(self.log_path) as log:
            return log.read()

    def round_trips(self):
        """Returns how many commands were run over ssh so far."""
        return self.log().count('Starting session: ')

    def run(self, command):
        """Returns what a command prints on the machine."""
        ssh = [
            'ssh', '-F', 'none', '-i', self.key, '-p', str(self.port),
            '-o', 'StrictHostKeyChecking=no', '-o', 'UserKnownHostsFile=/dev/null',
            '-o', 'LogLevel=ERROR', 'root@127.0.0.1', command,
        ]
        done = subprocess.run(ssh, stdin=subprocess.DEVNULL, capture_output=True, text=True)
        if done.returncode != 0:
            raise RuntimeError(f'{command}: {done.stdout}{done.stderr}')
        return done.stdout

    def stop(self):
        self.process.kill()
        self.process.wait()
        self.process.stdout.close()
