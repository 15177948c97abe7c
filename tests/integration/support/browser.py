"""A headless Chromium."""

import atexit
import functools
import io
import os
import subprocess
import tarfile
import tempfile

from support.machine import read
from support.wait import until

try:
    from selenium import webdriver
    from selenium.common.exceptions import ElementClickInterceptedException, StaleElementReferenceException
    from selenium.webdriver.chrome.service import Service
    from selenium.webdriver.common.by import By
    from selenium.webdriver.common.keys import Keys
except ImportError:
    webdriver = Keys = None

PICTURES = os.environ.get('MI_PICTURES', '')
AXE = os.path.join(os.path.dirname(os.environ.get('MI_PAGE', '')), 'node_modules', 'axe-core', 'axe.min.js')
NEEDED = ('chromium', 'chromedriver', '/usr/lib/python3/dist-packages/selenium')

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


class Browser:
    """A Chromium with its own profile."""

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
