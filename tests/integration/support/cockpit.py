"""The page in the real Cockpit and a headless Chromium.

For tests that run in a copy of this machine: an invented machine is laid over it, Cockpit becomes part
of it, and its network is a loopback interface of its own.
"""

import atexit
import functools
import io
import os
import pwd
import shutil
import signal
import socket
import subprocess
import tarfile
import tempfile
import time
import unittest

from support import environment

try:
    from selenium import webdriver
    from selenium.common.exceptions import ElementClickInterceptedException, StaleElementReferenceException
    from selenium.webdriver.chrome.service import Service
    from selenium.webdriver.common.by import By
    from selenium.webdriver.common.keys import Keys
except ImportError:
    webdriver = Keys = None

PAGE = os.environ.get('MI_PAGE', '')
PICTURES = os.environ.get('MI_PICTURES', '')
AXE = os.path.join(os.path.dirname(PAGE), 'node_modules', 'axe-core', 'axe.min.js')
MACHINE = os.path.join(environment.SOURCE, 'tests', 'machines', 'users-and-groups')
SELENIUM = '/usr/lib/python3/dist-packages/selenium'
WS = '/usr/lib/cockpit/cockpit-ws'
SHELL = '/usr/share/cockpit/shell'
NEEDED = (
    PAGE or 'npm', 'chromium', 'chromedriver', SELENIUM,
    'cockpit-bridge', environment.daemon(WS), environment.daemon(SHELL),
)

PORT = 9090
ADDRESS = f'http://127.0.0.1:{PORT}'
MIHOST = '/usr/local/bin/mihost'
CALLS = '/run/mihost-calls'
PROCESSES = '/run/mihost-processes'

# Cockpit starts this instead of the program. It records each call, and the arguments of every process of
# the machine at that time.
RECORDER = f'''#!/bin/sh
echo "$$ $*" >>{CALLS}
cat /proc/[0-9]*/cmdline 2>/dev/null | tr '\\0' ' ' >>{PROCESSES}
exec {environment.MIHOST} "$@"
'''
# Is killed in a preview, and does everything else.
DIES_IN_PREVIEW = RECORDER.replace('exec', '[ "$1" != --sandbox ] || kill -9 $$\nexec')

CHROMIUM = (
    '--headless', '--no-sandbox', '--disable-gpu', '--disable-quic', '--no-first-run',
    '--disable-background-networking', '--disable-component-update', '--disable-sync',
    '--disable-dev-shm-usage', '--hide-scrollbars', '--force-color-profile=srgb', '--lang=en',
)

# Records what the page's content security policy refuses.
WATCH_POLICY = '''
window.refused = [];
document.addEventListener('securitypolicyviolation', event => {
    window.refused.push(event.violatedDirective + ' ' + event.blockedURI + ' ' + event.sample);
});
'''

FIND_BUTTON = '''
return [...document.querySelectorAll(arguments[0] + ' :is(button, a, [role=button], [role=tab])')]
    .find(element => element.checkVisibility() && !element.disabled &&
        (element.ariaLabel || element.innerText).trim() === arguments[1]);
'''


def write(path, text, mode=0o644):
    with open(path, 'w') as file:
        file.write(text)
    os.chmod(path, mode)


def read(path):
    with open(path) as file:
        return file.read()


def install_mihost(script=RECORDER):
    """Puts a program where the page looks for mihost.

    Renamed into place: a file cannot be written while it is being started.
    """
    draft = MIHOST + '.new'
    write(draft, script, 0o755)
    os.replace(draft, MIHOST)


def install_cockpit():
    """Makes Cockpit and the page part of this copy of the machine."""
    for path in ('/usr/lib/cockpit', SHELL, '/usr/share/cockpit/static'):
        unpacked = environment.daemon(path)
        if unpacked != path:
            shutil.copytree(unpacked, path, dirs_exist_ok=True)
    shutil.copytree(PAGE, '/usr/share/cockpit/mihost')
    forget_calls()
    install_mihost()


def lay_machine():
    """The invented machine, with modules and a log."""
    shutil.copytree(MACHINE, '/', dirs_exist_ok=True)
    os.chmod('/etc/shadow', 0o600)
    for name, script in (
        ('lsmod', 'echo Module Size Used by; echo one 1 0; echo two 1 0'),
        ('modinfo', 'echo "version:        1.$1"'),
    ):
        path = f'/usr/sbin/{name}'
        if os.path.lexists(path):
            os.unlink(path)
        write(path, f'#!/bin/sh\n{script}\n', 0o755)
    write('/var/log/messages', log_lines(['one', 'two', 'three']))


def log_lines(messages):
    stamp = time.strftime('%b %e %H:%M:%S')
    return ''.join(f'{stamp} mole test: {message}\n' for message in messages)


def accounts_file(name):
    """Returns the lines of an account file, keyed by the name that they begin with."""
    return {line.split(':')[0]: line for line in read(f'/etc/{name}').splitlines()}


def forget_calls():
    for file in (CALLS, PROCESSES):
        write(file, '', 0o666)


def calls():
    """Returns the arguments of each call of mihost since the page was opened."""
    return [line.partition(' ')[2] for line in read(CALLS).splitlines()]


def running(arguments):
    """Returns the process ids of the running mihosts with such arguments."""
    called = [line.split()[0] for line in read(CALLS).splitlines() if arguments in line]
    return [int(process) for process in called if os.path.exists(f'/proc/{process}')]


def kill_mihost(arguments):
    """Kills the mihost with such arguments, as soon as it runs."""
    os.kill(until(lambda: running(arguments), f'no mihost {arguments}')[-1], signal.SIGKILL)


def until(condition, what, seconds=60):
    """Waits until the condition is true and returns it; gives up after the limit."""
    deadline = time.monotonic() + seconds
    while True:
        result = condition()
        if result:
            return result
        if time.monotonic() > deadline:
            raise TimeoutError(what() if callable(what) else what)
        time.sleep(0.05)


def listening():
    with socket.socket() as connection:
        return connection.connect_ex(('127.0.0.1', PORT)) == 0


def session_of(account):
    """Returns the command that starts a session of an account without a login."""
    if account == 'root':
        return '/usr/bin/cockpit-bridge'
    identity = pwd.getpwnam(account)
    write('/run/session', f"""#!/bin/sh
HOME=/tmp USER={account} LOGNAME={account}
export HOME USER LOGNAME
exec setpriv --reuid={identity.pw_uid} --regid={identity.pw_gid} --clear-groups /usr/bin/cockpit-bridge
""", 0o755)
    return '/run/session'


class Cockpit:
    """A running cockpit-ws, to log in to or with the session of an account."""

    def __init__(self, account=None):
        session = [f'--local-session={session_of(account)}'] if account else []
        self.process = subprocess.Popen(
            [WS, '--no-tls', '--address=127.0.0.1', f'--port={PORT}', *session],
            stdin=subprocess.DEVNULL, stdout=subprocess.DEVNULL, stderr=subprocess.DEVNULL,
            env={'PATH': '/usr/local/bin:/usr/sbin:/usr/bin:/sbin:/bin', 'LC_ALL': 'C.UTF-8', 'HOME': '/root'},
        )
        until(lambda: self.process.poll() is not None or listening(), 'cockpit-ws does not listen')
        if self.process.returncode is not None:
            raise RuntimeError(f'cockpit-ws ended with {self.process.returncode} (run {WS})')

    def stop(self):
        self.process.kill()
        self.process.wait()


class Browser:
    """A Chromium with its own profile, and the page in it."""

    def __init__(self):
        self.profile = tempfile.TemporaryDirectory(prefix='mi-chromium-', ignore_cleanup_errors=True)
        options = webdriver.ChromeOptions()
        for argument in (*CHROMIUM, f'--user-data-dir={self.profile.name}'):
            options.add_argument(argument)
        options.set_capability('goog:loggingPrefs', {'browser': 'ALL'})
        options.page_load_strategy = 'none'  # load() waits instead
        service = Service('/usr/bin/chromedriver', log_path=os.devnull)
        self.driver = webdriver.Chrome(service=service, options=options)
        self.driver.execute_cdp_cmd('Page.addScriptToEvaluateOnNewDocument', {'source': WATCH_POLICY})
        self.size(1280, 900)
        self.scheme('light')

    def stop(self):
        self.driver.quit()
        self.profile.cleanup()

    def size(self, width, height):
        """Sets the size of the page itself, in CSS pixels."""
        self.driver.execute_cdp_cmd('Emulation.setDeviceMetricsOverride', {
            'width': width, 'height': height, 'deviceScaleFactor': 1, 'mobile': False,
        })

    def scheme(self, name):
        """Sets the colour scheme, light or dark; animations are off, so that a picture is final."""
        self.driver.execute_cdp_cmd('Emulation.setEmulatedMedia', {'features': [
            {'name': 'prefers-color-scheme', 'value': name},
            {'name': 'prefers-reduced-motion', 'value': 'reduce'},
        ]})

    def load(self, address):
        """Goes to an address. The page is asked whether it is loaded: chromedriver sometimes misses it for minutes."""
        self.driver.get(address)
        self.wait(
            'return document.readyState === "complete" && location.href.startsWith(arguments[0])', address,
            what=f'{address} is not loaded',
        )

    def open(self, tab=None):
        """Loads the page again with a tab of it chosen; the earlier calls of mihost are forgotten."""
        self.load('about:blank')
        forget_calls()
        self.load(f'{ADDRESS}/cockpit/@localhost/mihost/index.html')
        if tab:
            self.click(f'#tab-{tab}')

    def leave(self):
        """Leaves the page and deletes its cookies, the session included."""
        self.driver.switch_to.default_content()
        self.driver.delete_all_cookies()
        self.load('about:blank')

    def enter(self, css):
        """Enters a frame: elements are looked for in it from now on."""
        self.driver.switch_to.frame(self.shown(css))

    def run(self, script, *arguments):
        """Returns what a piece of JavaScript returns."""
        return self.driver.execute_script(script, *arguments)

    def wait(self, script, *arguments, what=None):
        """Waits until a piece of JavaScript returns something true."""
        return until(
            lambda: self.run(script, *arguments),
            what or (lambda: f'{script} {arguments}: {self.body()[:2000]}'),
        )

    def body(self):
        return self.run('return document.body.innerText')

    def find(self, css):
        return self.driver.find_elements(By.CSS_SELECTOR, css)

    def shown(self, css):
        """Returns the first displayed element that matches; waits for one."""
        def first():
            try:
                return next((each for each in self.find(css) if each.is_displayed()), None)
            except StaleElementReferenceException:
                return None
        return until(first, lambda: f'no {css}: {self.body()[:2000]}')

    def gone(self, css):
        self.wait('return ![...document.querySelectorAll(arguments[0])].some(e => e.checkVisibility())', css)

    def act(self, css, action):
        """Does something with an element, as soon as it is enabled and does not move."""
        def attempt():
            try:
                element = self.shown(css)
                if not element.is_enabled():
                    return False
                action(element)
                return True
            except (StaleElementReferenceException, ElementClickInterceptedException):
                return False
        until(attempt, f'{css} is off, or keeps moving')

    def click(self, css):
        def click(element):
            self.run('arguments[0].scrollIntoView({block: "nearest", inline: "nearest", behavior: "instant"})', element)
            element.click()
        self.act(css, click)

    def type(self, css, text):
        """Replaces the text of a field as a user would."""
        def enter(element):
            element.send_keys(Keys.CONTROL, 'a')
            element.send_keys(Keys.DELETE)
            element.send_keys(text)
        self.act(css, enter)

    def press(self, *keys):
        self.driver.switch_to.active_element.send_keys(*keys)

    def tab_to(self, css):
        """Presses the tab key until the element has the focus; fails if it never has."""
        for _ in range(100):
            if self.run('return document.activeElement?.matches(arguments[0])', css):
                return
            self.press(Keys.TAB)
        raise AssertionError(f'no way to {css} with the keyboard')

    def text(self, css):
        """Returns the text that an element shows."""
        return self.run('return document.querySelector(arguments[0])?.innerText ?? ""', css)

    def attributes(self, css, name):
        """Returns an attribute of all elements that match."""
        return self.run(
            'return [...document.querySelectorAll(arguments[0])].map(e => e.getAttribute(arguments[1]))', css, name,
        )

    def texts(self, css):
        """Returns the texts of all displayed elements that match."""
        return self.run(
            'return [...document.querySelectorAll(arguments[0])]'
            '.filter(e => e.checkVisibility()).map(e => e.innerText)', css,
        )

    def see(self, css, *texts):
        """Waits until an element shows all of the texts."""
        for text in texts:
            self.wait(
                'const e = document.querySelector(arguments[0]);'
                'return e && e.checkVisibility() && e.innerText.includes(arguments[1])',
                css, text, what=lambda: f'{css} lacks {text!r}: {self.text(css)[:2000]}',
            )

    def not_seen(self, css, text):
        self.wait(
            'return !(document.querySelector(arguments[0])?.innerText ?? "").includes(arguments[1])', css, text,
        )

    def button(self, name, within='body'):
        """Clicks the button with this accessible name."""
        def attempt():
            found = self.run(FIND_BUTTON, within, name)
            try:
                if found:
                    found.click()
                return bool(found)
            except (StaleElementReferenceException, ElementClickInterceptedException):
                return False
        until(attempt, lambda: f'no button {name!r}: {self.body()[:2000]}')

    def settle(self):
        """Waits until all animations have ended."""
        self.wait('return document.getAnimations().every(each => each.playState === "finished")')

    def axe(self):
        """Returns what axe-core finds serious or worse in the page: rule and element."""
        self.settle()
        self.run(read(AXE))
        found = self.driver.execute_async_script(
            'const done = arguments[0]; axe.run(document, {resultTypes: ["violations"]}).then(done);'
        )
        return [
            (violation['id'], node['html'], node['failureSummary'])
            for violation in found['violations'] if violation['impact'] in ('serious', 'critical')
            for node in violation['nodes']
        ]

    def refused(self):
        """Returns what the content security policy refused since the page was opened."""
        return self.run('return window.refused')

    def complaints(self):
        """Returns the problems in the browser's console since the last call."""
        return [entry['message'] for entry in self.driver.get_log('browser')
                if entry['level'] in ('SEVERE', 'WARNING') and '/favicon.ico' not in entry['message']]

    def picture(self, name):
        """Saves a picture of the page in the build directory."""
        self.settle()
        content = self.driver.get_screenshot_as_png()
        entry = tarfile.TarInfo(name + '.png')
        entry.size = len(content)
        pictures().addfile(entry, io.BytesIO(content))


class PageTest(unittest.TestCase):
    """A test of the page; Cockpit and the browser serve all tests of the class."""

    ACCOUNT = 'root'

    @classmethod
    def setUpClass(cls):
        cls.prepare()
        cls.cockpit = Cockpit(cls.ACCOUNT)
        cls.addClassCleanup(cls.cockpit.stop)
        cls.browser = Browser()
        cls.addClassCleanup(cls.browser.stop)

    @classmethod
    def prepare(cls):
        """Prepares the machine for the tests of the class."""
        lay_machine()


def send_pictures():
    """Starts a process outside the copy that writes the pictures, as no file leaves the copy."""
    os.makedirs(PICTURES, exist_ok=True)
    reader, writer = os.pipe()
    subprocess.Popen(['tar', '-x', '-C', PICTURES], stdin=reader)
    os.close(reader)
    os.set_inheritable(writer, True)
    os.environ['MI_PICTURES_PIPE'] = str(writer)


@functools.cache
def pictures():
    pipe = os.fdopen(int(os.environ['MI_PICTURES_PIPE']), 'wb')
    archive = tarfile.open(fileobj=pipe, mode='w|')
    atexit.register(pipe.close)
    atexit.register(archive.close)
    return archive


def main():
    environment.skip_or_fail_without(NEEDED)
    if 'MI_PICTURES_PIPE' in os.environ:
        pictures()  # an empty archive where a test takes none
    else:
        send_pictures()
    environment.main_in_sandbox(*NEEDED)
