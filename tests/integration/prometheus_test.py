"""The figures of an invented machine in the real Prometheus, by the textfile collector and directly.

Everything runs in one copy of this machine, whose network is a loopback interface of its own.
"""

import json
import os
import re
import shutil
import subprocess
import tempfile
import unittest
import urllib.error
import urllib.parse
import urllib.request

from support import environment, machine
from support.wait import until

PROMETHEUS = os.path.join(environment.SOURCE, 'integrations', 'prometheus')
EXPORTER = os.path.join(environment.BIN, 'mihost-exporter')

EXPORTER_PORT, NODE_PORT, PROMETHEUS_PORT = 9811, 9100, 9090

CONFIGURATION = f'''
global: {{scrape_interval: 1s, scrape_timeout: 1s}}
scrape_configs:
  - job_name: direct
    static_configs: [{{targets: ['127.0.0.1:{EXPORTER_PORT}']}}]
  - job_name: textfile
    static_configs: [{{targets: ['127.0.0.1:{NODE_PORT}']}}]
'''


def get(port, path, method='GET'):
    """Returns the status, content type and body of the answer."""
    request = urllib.request.Request(f'http://127.0.0.1:{port}{path}', method=method)
    try:
        with urllib.request.urlopen(request, timeout=30) as answer:
            return answer.status, answer.headers['Content-Type'], answer.read().decode()
    except urllib.error.HTTPError as error:
        with error:
            return error.code, error.headers['Content-Type'], error.read().decode()


def until_served(condition, what):
    """As until, while nothing answers or half an answer comes."""
    return until(condition, what, retry=(urllib.error.URLError, ConnectionError, json.JSONDecodeError))


def query(expression):
    """Returns the samples of an expression in Prometheus."""
    path = '/api/v1/query?' + urllib.parse.urlencode({'query': expression})
    answer = json.loads(get(PROMETHEUS_PORT, path)[2])
    if answer['status'] != 'success':
        raise ValueError(f'{expression}: {answer}')
    return answer['data']['result']


def mihost(*arguments):
    return subprocess.run([environment.MIHOST, *arguments], check=True, capture_output=True, text=True).stdout


def series(text):
    """Returns the series of a metrics text, each with its value."""
    lines = [line.rpartition(' ') for line in text.splitlines() if not line.startswith('#')]
    return {name: float(value) for name, _, value in lines}


class Daemons(unittest.TestCase):
    @classmethod
    def start(cls, *command, **options):
        process = subprocess.Popen(
            command, stdin=subprocess.DEVNULL, stdout=subprocess.DEVNULL, stderr=subprocess.DEVNULL, **options
        )
        cls.addClassCleanup(process.wait)
        cls.addClassCleanup(process.kill)
        return process

    @classmethod
    def start_exporter(cls, port, *command):
        """Starts the exporter as systemd does, with a socket."""
        return cls.start('systemd-socket-activate', '-l', f'127.0.0.1:{port}', EXPORTER, *command)


class Exporter(Daemons):
    def setUp(self):
        self.process = self.start_exporter(EXPORTER_PORT, environment.MIHOST, 'metrics')
        until_served(lambda: get(EXPORTER_PORT, '/')[0] == 404, 'no exporter')

    def tearDown(self):
        self.process.terminate()
        self.assertEqual(self.process.wait(), 0)  # it ends when systemd stops it

    def test_answers_with_metrics(self):
        status, kind, body = get(EXPORTER_PORT, '/metrics')
        self.assertEqual((status, kind), (200, 'application/openmetrics-text; version=1.0.0; charset=utf-8'))
        self.assertEqual(series(body)['mi_users'], 4)
        self.assertTrue(body.endswith('# EOF\n'))

    def test_answers_nothing_else(self):
        self.assertEqual(get(EXPORTER_PORT, '/etc/passwd')[0], 404)
        self.assertEqual(get(EXPORTER_PORT, '/metrics', 'POST')[0], 405)
        self.assertEqual(get(EXPORTER_PORT, '/metrics', 'HEAD')[::2], (200, ''))

    def test_names_no_account(self):
        for name in ('anna', 'ben', 'carl'):
            self.assertNotIn(name, get(EXPORTER_PORT, '/metrics')[2])

    def test_command_does_not_get_the_socket(self):
        self.start_exporter(9812, '/bin/sh', '-c', 'env; ls -l /proc/$$/fd')
        body = until_served(lambda: get(9812, '/metrics')[2], 'no exporter')
        self.assertIn('PATH=', body)
        self.assertNotIn('LISTEN_', body)
        self.assertIn('pipe:', body)
        self.assertNotIn('socket:', body)


class ExporterAlone(Daemons):
    def test_says_when_there_are_no_metrics(self):
        self.start_exporter(9813, '/bin/false')
        status, _, body = until_served(lambda: get(9813, '/metrics'), 'no exporter')
        self.assertEqual((status, body), (500, 'mihost printed no metrics\n'))

    def test_needs_a_socket(self):
        done = subprocess.run([EXPORTER, '/bin/true'], capture_output=True, text=True)
        self.assertEqual(done.returncode, 2)
        self.assertIn('no socket was passed', done.stderr)
        self.assertEqual(subprocess.run([EXPORTER], capture_output=True).returncode, 2)

    def test_needs_no_more_than_the_units_privileges(self):
        """Runs it as the service does: not as root, with one capability."""
        read = '+dac_read_search'
        done = subprocess.run(
            ['setpriv', '--reuid=65534', '--regid=65534', '--clear-groups', '--no-new-privs',
             f'--inh-caps=-all,{read}', f'--ambient-caps=-all,{read}', f'--bounding-set=-all,{read}',
             environment.MIHOST, 'metrics'],
            capture_output=True, text=True, check=True,
        )
        ours = series(mihost('metrics'))
        theirs = series(done.stdout)
        self.assertEqual(set(theirs), set(ours))
        self.assertEqual(theirs['mi_accounts_expired'], ours['mi_accounts_expired'])


class Units(unittest.TestCase):
    UNITS = ('mihost-exporter.service', 'mihost-exporter.socket', 'mihost-metrics.service', 'mihost-metrics.timer')

    def setUp(self):
        """Writes the units, with the programs of this build."""
        self.folder = tempfile.mkdtemp()
        self.addCleanup(shutil.rmtree, self.folder)
        values = {
            'CMAKE_INSTALL_FULL_LIBEXECDIR': self.folder,
            'CMAKE_INSTALL_FULL_BINDIR': environment.BIN,
            'MI_TEXTFILE_DIR': '/var/lib/prometheus/node-exporter',
        }
        os.mkdir(os.path.join(self.folder, 'mihost'))
        os.symlink(EXPORTER, os.path.join(self.folder, 'mihost', 'mihost-exporter'))
        for unit in self.UNITS:
            with open(os.path.join(PROMETHEUS, 'systemd', unit + '.in')) as template:
                text = re.sub('@([A-Z_]+)@', lambda match: values[match[1]], template.read())
            with open(self.path(unit), 'w') as file:
                file.write(text)

    def path(self, unit):
        return os.path.join(self.folder, unit)

    def test_systemd_accepts_them(self):
        done = subprocess.run(
            ['systemd-analyze', 'verify', '--man=no', *map(self.path, self.UNITS)], capture_output=True, text=True
        )
        own = [line for line in done.stderr.splitlines() if 'mihost' in line]
        self.assertEqual(own, [])

    def test_services_are_hardened(self):
        for unit in self.UNITS[::2]:
            done = subprocess.run(
                ['systemd-analyze', 'security', '--offline=yes', '--threshold=20', self.path(unit)],
                capture_output=True, text=True,
            )
            self.assertEqual(done.returncode, 0, done.stdout[-600:])


class Scraped(Daemons):
    @classmethod
    def setUpClass(cls):
        cls.folder = tempfile.mkdtemp()
        cls.addClassCleanup(shutil.rmtree, cls.folder)
        cls.textfile = os.path.join(cls.folder, 'mihost.prom')
        mihost('metrics', '--accounts', '--output', cls.textfile)
        configuration = os.path.join(cls.folder, 'prometheus.yml')
        with open(configuration, 'w') as file:
            file.write(CONFIGURATION)
        cls.start_exporter(EXPORTER_PORT, environment.MIHOST, 'metrics')
        cls.start(
            environment.NODE_EXPORTER, f'--web.listen-address=127.0.0.1:{NODE_PORT}',
            '--collector.disable-defaults', '--collector.textfile',
            f'--collector.textfile.directory={cls.folder}',
        )
        cls.start(
            environment.PROMETHEUS, f'--config.file={configuration}',
            f'--storage.tsdb.path={cls.folder}/data', f'--web.listen-address=127.0.0.1:{PROMETHEUS_PORT}',
        )
        for job in ('direct', 'textfile'):
            until_served(lambda: query(f'mi_collection_success{{job="{job}"}}'), f'no metrics of {job}')

    def value(self, expression):
        samples = query(expression)
        self.assertEqual(len(samples), 1, expression)
        return float(samples[0]['value'][1])

    def test_both_sources_have_the_trees_values(self):
        system = {
            name: entry['value']
            for name, entry in json.loads(mihost('--json', 'get', 'os'))['properties'].items()
        }
        users = len(json.loads(mihost('--json', 'list', 'users')))
        for job in ('direct', 'textfile'):
            with self.subTest(job):
                label = f'{{job="{job}"}}'
                self.assertEqual(self.value(f'mi_memory_size_bytes{label}'), system['physical-memory-size'] * 1024)
                # Each run computes it from the time of day and the uptime, both in whole seconds.
                self.assertAlmostEqual(self.value(f'mi_boot_time_seconds{label}'), system['last-boot-time'], delta=1)
                self.assertEqual(self.value(f'mi_users{label}'), users)
                self.assertEqual(self.value(f'mi_groups{label}'), 4)
                self.assertEqual(self.value(f'mi_log_lines{label}'), 3)
                self.assertEqual(self.value(f'mi_accounts_expired{label}'), 3)
                self.assertEqual(self.value(f'mi_driver_info{{job="{job}",driver="two",version="1.two"}}'), 1)

    def test_both_sources_have_every_series(self):
        expected = len(series(mihost('metrics')))
        self.assertEqual(self.value('count({__name__=~"mi_.*", job="direct"})'), expected)
        with_accounts = len(series(mihost('metrics', '--accounts')))
        self.assertEqual(self.value('count({__name__=~"mi_.*", job="textfile"})'), with_accounts)
        self.assertGreater(with_accounts, expected)
        self.assertEqual(self.value('node_textfile_scrape_error'), 0)

    def test_account_names_are_labels_only_on_request(self):
        self.assertEqual(query('mi_account_disabled{job="direct"}'), [])
        users = {sample['metric']['user'] for sample in query('mi_account_disabled{job="textfile"}')}
        self.assertEqual(users, {'root', 'anna', 'ben', 'carl'})

    def test_a_failed_collection_is_seen(self):
        subprocess.run(
            [environment.MIHOST, '--plugin', '/none', 'metrics', '--output', self.textfile], stderr=subprocess.DEVNULL
        )
        try:
            until_served(lambda: self.value('mi_collection_success{job="textfile"}') == 0, 'the failure is not seen')
        finally:
            mihost('metrics', '--accounts', '--output', self.textfile)
            until_served(lambda: self.value('mi_collection_success{job="textfile"}') == 1, 'no metrics any more')

    def test_every_query_of_the_dashboard_has_an_answer(self):
        with open(os.path.join(PROMETHEUS, 'grafana', 'mihost.json')) as file:
            dashboard = json.load(file)
        panels = dashboard['panels']
        self.assertGreater(len(panels), 10)
        self.assertEqual(len({panel['id'] for panel in panels}), len(panels))
        variables = {variable['name'] for variable in dashboard['templating']['list']}
        for panel in panels:
            self.assertEqual(panel['datasource']['uid'], '${datasource}')
            for target in panel['targets']:
                with self.subTest(panel['title']):
                    used = set(re.findall(r'\$(\w+)', target['expr']))
                    self.assertLessEqual(used, variables)
                    self.assertTrue(query(target['expr'].replace('$instance', '.*')), target['expr'])


class Tools(unittest.TestCase):
    def promtool(self, *arguments, **options):
        done = subprocess.run([environment.PROMTOOL, *arguments], capture_output=True, text=True, **options)
        self.assertEqual((done.returncode, done.stderr), (0, ''), done.stdout)

    def test_metrics_pass_the_check(self):
        self.promtool('check', 'metrics', input=mihost('metrics', '--accounts'))

    def test_rules_fire_when_they_should(self):
        with tempfile.TemporaryDirectory() as folder:
            shutil.copy(os.path.join(PROMETHEUS, 'rules', 'mihost.yml'), folder)
            shutil.copy(os.path.join(os.path.dirname(__file__), 'prometheus', 'rules_test.yml'), folder)
            self.promtool('check', 'rules', 'mihost.yml', cwd=folder)
            self.promtool('test', 'rules', 'rules_test.yml', cwd=folder)


def setUpModule():
    machine.lay()


if __name__ == '__main__':
    environment.main_in_sandbox(
        environment.PROMETHEUS, environment.PROMTOOL, environment.NODE_EXPORTER, EXPORTER,
        'systemd-socket-activate', 'systemd-analyze', 'setpriv',
    )
