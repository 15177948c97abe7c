"""target.py SSHD SOCKET KEYS: in a sandbox, serves a listening socket with an sshd per connection."""

import os
import shutil
import socket
import subprocess
import sys

CONFIGURATION = '''
HostKey {keys}/host
AuthorizedKeysFile {keys}/user.pub
StrictModes no
UsePAM no
PermitRootLogin prohibit-password
PasswordAuthentication no
LogLevel VERBOSE
PidFile none
'''


def prepare(machine, mihost, keys):
    """Puts the files of the invented machine over this copy and prepares it for sshd."""
    shutil.copytree(machine, '/', dirs_exist_ok=True)
    os.chmod('/etc/shadow', 0o640)
    with open('/etc/passwd', 'a') as accounts:
        accounts.write('sshd:x:101:65534::/run/sshd:/usr/sbin/nologin\n')
    os.makedirs('/run/sshd', mode=0o755)
    os.symlink(mihost, '/usr/local/bin/mihost')
    with open('/run/sshd_config', 'w') as configuration:
        configuration.write(CONFIGURATION.format(keys=keys))


def main():
    machine, mihost, sshd, descriptor, keys, setup = sys.argv[1:]
    listener = socket.socket(fileno=int(descriptor))
    prepare(machine, mihost, keys)
    subprocess.run(['sh', '-ec', setup], check=True)
    print('ready', flush=True)
    children = []
    while True:
        connection, _ = listener.accept()
        command = [sshd, '-i', '-e', '-f', '/run/sshd_config']
        children.append(subprocess.Popen(command, stdin=connection, stdout=connection))
        connection.close()
        children = [child for child in children if child.poll() is None]


main()
