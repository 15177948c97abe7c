"""scrapes.py [ROUNDS]: the cost of a scrape of mihost, compared with node_exporter's own collectors.

Runs in a copy of this machine, which it starts.
"""

import gzip
import os
import re
import resource
import shutil
import subprocess
import sys
import tempfile
import time
import urllib.request

sys.path.insert(0, os.path.join(os.environ['MI_SOURCE'], 'tests', 'integration'))
from measure import alternating, cell, table
from support import environment

EXPORTER, OWN, TEXTFILE = 9811, 9100, 9101
TICKS = os.sysconf('SC_CLK_TCK')


def get(port):
    with urllib.request.urlopen(f'http://127.0.0.1:{port}/metrics', timeout=30) as answer:
        return answer.read()


def wait_for(port):
    for _ in range(600):
        try:
            return get(port)
        except OSError:
            time.sleep(0.1)
    raise TimeoutError(f'nothing answers on {port}')


def processor_seconds(pid):
    """Returns the processor time of the process and the children that it waited for, in seconds."""
    with open(f'/proc/{pid}/stat') as stat:
        fields = stat.read().rpartition(')')[2].split()
    return sum(int(field) for field in fields[11:15]) / TICKS


def resident(pid):
    with open(f'/proc/{pid}/status') as status:
        return int(re.search(r'VmRSS:\s+(\d+)', status.read())[1]) / 1024


def start(*command):
    return subprocess.Popen(command, stdout=subprocess.DEVNULL, stderr=subprocess.DEVNULL)


def timed_scrape(port):
    begin = time.monotonic()
    get(port)
    return (time.monotonic() - begin) * 1000


def inside(rounds):
    machine = os.path.join(environment.SOURCE, 'tests', 'machines', 'users-and-groups')
    shutil.copytree(machine, '/', dirs_exist_ok=True)
    folder = tempfile.mkdtemp()
    mihost = environment.MIHOST
    command = [mihost, 'metrics', '--output', f'{folder}/mihost.prom']

    def write():
        before = resource.getrusage(resource.RUSAGE_CHILDREN)
        begin = time.monotonic()
        subprocess.run(command, check=True)
        seconds = time.monotonic() - begin
        after = resource.getrusage(resource.RUSAGE_CHILDREN)
        used = after.ru_utime + after.ru_stime - before.ru_utime - before.ru_stime
        return seconds * 1000, used * 1000

    write()
    node = environment.NODE_EXPORTER
    servers = {
        'exporter: a scrape runs `mihost metrics`': (
            EXPORTER, start('systemd-socket-activate', '-l', f'127.0.0.1:{EXPORTER}',
                            os.path.join(environment.BIN, 'mihost-exporter'), mihost, 'metrics')),
        'node_exporter, the textfile alone': (
            TEXTFILE, start(node, f'--web.listen-address=127.0.0.1:{TEXTFILE}', '--collector.disable-defaults',
                            '--collector.textfile', f'--collector.textfile.directory={folder}')),
        "node_exporter's own collectors": (
            OWN, start(node, f'--web.listen-address=127.0.0.1:{OWN}', '--no-collector.textfile')),
    }
    texts = {name: wait_for(port) for name, (port, _) in servers.items()}
    before = {name: processor_seconds(server.pid) for name, (_, server) in servers.items()}
    times = alternating({name: lambda port=port: timed_scrape(port) for name, (port, _) in servers.items()}, rounds)
    writes = [write() for _ in range(rounds)]
    rows = []
    for name, (_, server) in servers.items():
        used = (processor_seconds(server.pid) - before[name]) / rounds * 1000
        text = texts[name]
        series = sum(1 for line in text.splitlines() if line and not line.startswith(b'#'))
        rows.append([name, cell(times[name], 1), f'{used:.1f}', series, f'{len(text) / 1000:.1f}',
                     f'{len(gzip.compress(text)) / 1000:.1f}', f'{resident(server.pid):.0f}'])
        server.kill()
    rows.append(['timer: writes the textfile, each minute', cell([each[0] for each in writes], 1),
                 f'{sum(each[1] for each in writes) / rounds:.1f}', '-', '-', '-', '-'])
    shutil.rmtree(folder)
    print(table(['What', 'Time, ms', 'Processor time, ms', 'Series', 'Text, kB', 'Compressed, kB',
                 'Resident between scrapes, MiB'], rows))


def main():
    rounds = int(sys.argv[1]) if len(sys.argv) > 1 else 100
    if len(sys.argv) < 3:
        command = [environment.SANDBOXED, sys.executable, sys.argv[0], str(rounds), 'inside']
        os.execv(command[0], command)
    inside(rounds)


main()
