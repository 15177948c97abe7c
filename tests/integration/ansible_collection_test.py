"""Ansible's own tools build, install and check the collection and its documentation."""

import glob
import json
import os
import shutil
import subprocess
import unittest

from support import environment
from support.ansible import COLLECTION, Controller

MODULES = ['mi_call', 'mi_group', 'mi_info', 'mi_set', 'mi_user']

# The tests of ansible-test that need no network. Newer versions lack some.
SANITY = '''
    action-plugin-docs compile empty-init future-import-boilerplate ignores line-endings
    metaclass-boilerplate no-assert no-basestring no-dict-iteritems no-dict-iterkeys no-dict-itervalues
    no-get-exception no-illegal-filenames no-main-display no-smart-quotes no-unicode-literals
    replace-urlopen shebang symlinks use-argspec-type-path use-compat-six
'''.split()

PACKAGES = '/usr/lib/python3/dist-packages'
VALIDATOR = PACKAGES + '/ansible_test/_util/controller/sanity/validate-modules'
PYTHON = '/usr/bin/python3'  # Debian's, which has the validator's modules

# This project has no licence yet.
LICENCE = 'missing-gplv3-license'


class Collection(unittest.TestCase):
    @classmethod
    def setUpClass(cls):
        cls.controller = Controller()
        cls.addClassCleanup(cls.controller.stop)
        built = cls.controller.run('ansible-galaxy', 'collection', 'build', COLLECTION)
        if built.returncode != 0:
            raise RuntimeError(built.stdout + built.stderr)
        cls.archive, = glob.glob(cls.controller.path('mi-host-*.tar.gz'))
        done = cls.controller.run(
            'ansible-galaxy', 'collection', 'install', cls.archive, '-p', cls.controller.path('collections')
        )
        if done.returncode != 0:
            raise RuntimeError(done.stdout + done.stderr)
        cls.installed = cls.controller.path('collections', 'ansible_collections', 'mi', 'host')

    def test_is_installed_from_its_archive(self):
        installed = glob.glob(os.path.join(self.installed, 'plugins', 'modules', '*.py'))
        self.assertEqual(sorted(os.path.basename(path)[:-3] for path in installed), MODULES)
        listed = self.controller.run('ansible-galaxy', 'collection', 'list', 'mi.host').stdout
        version = os.path.basename(self.archive)[len('mi-host-'):-len('.tar.gz')]
        self.assertIn(version, listed)
        leftovers = [path for path in glob.glob(self.installed + '/**', recursive=True) if '.pyc' in path]
        self.assertEqual(leftovers, [])

    def test_every_module_is_documented(self):
        names = [f'mi.host.{name}' for name in MODULES]
        done = self.controller.run('ansible-doc', '--json', *names)
        self.assertEqual((done.returncode, done.stderr), (0, ''))
        documents = json.loads(done.stdout)
        self.assertEqual(sorted(documents), names)
        for name, document in documents.items():
            with self.subTest(name):
                self.assertIn('mihost', document['doc']['options'])
                self.assertIn('check_mode', document['doc']['attributes'])
                self.assertTrue(document['examples'])
                self.assertTrue(document['return'])
                self.assertEqual(self.controller.run('ansible-doc', name).returncode, 0)

    def test_passes_the_sanity_tests(self):
        copy = self.controller.path('sanity', 'ansible_collections', 'mi', 'host')
        shutil.copytree(self.installed, copy)
        subprocess.run(['git', 'init', '-q', copy], check=True)
        version = subprocess.run([PYTHON, '--version'], capture_output=True, text=True).stdout
        major, minor = version.split()[1].split('.')[:2]
        listed = subprocess.run(
            ['ansible-test', 'sanity', '--list-tests'],
            cwd=copy, env=self.controller.environment, capture_output=True, text=True,
        )
        options = [word for test in SANITY if test in listed.stdout.split() for word in ('--test', test)]
        self.assertTrue(options, listed.stderr)
        done = subprocess.run(
            ['ansible-test', 'sanity', '--python', f'{major}.{minor}', *options],
            cwd=copy, env=self.controller.environment, capture_output=True, text=True,
        )
        self.assertEqual(done.returncode, 0, done.stdout + done.stderr)

    def test_documentation_fits_the_arguments(self):
        done = subprocess.run(
            [PYTHON, os.path.join(VALIDATOR, 'validate.py'), '--format', 'json', '--arg',
             '--collection', 'ansible_collections/mi/host',
             *(f'plugins/modules/{name}.py' for name in MODULES)],
            cwd=self.installed, env={**self.controller.environment, 'PYTHONPATH': VALIDATOR},
            capture_output=True, text=True,
        )
        if 'ModuleNotFoundError' in done.stderr:
            self.skipTest(done.stderr.splitlines()[-1])  # one that Debian 13 lacks
        findings = [
            (path, error['code'], error['msg'])
            for path, report in json.loads(done.stdout).items()
            for error in report['errors']
        ]
        self.assertEqual(len(findings), len(MODULES), findings)  # so each was looked at
        self.assertEqual({code for _, code, _ in findings}, {LICENCE}, findings)


if __name__ == '__main__':
    environment.main(
        'ansible-galaxy', 'ansible-doc', 'ansible-test', 'ssh-keygen', 'git', VALIDATOR,
        PACKAGES + '/voluptuous',
    )
