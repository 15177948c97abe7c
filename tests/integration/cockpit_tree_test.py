"""The tree in the page: every node, search, kinds, properties, and values that change."""

import csv
import io
import subprocess

from support import cockpit, environment
from support.browser import Keys
from support.cockpit import PageTest
from support.wait import until


def rows(*arguments):
    """Returns the rows that mihost itself prints."""
    done = subprocess.run(
        [environment.MIHOST, '-o', 'csv', *arguments], check=True, capture_output=True, text=True
    )
    return list(csv.DictReader(io.StringIO(done.stdout)))


class Tree(PageTest):
    def setUp(self):
        self.browser.open()
        self.browser.see('#tree', 'anna')

    def addresses(self):
        return self.browser.attributes('#tree [role=treeitem]', 'data-address')

    def listed(self, *addresses):
        """Waits until exactly these nodes are listed."""
        until(lambda: self.addresses() == list(addresses), lambda: str(self.addresses()))

    def choose(self, address):
        self.browser.click(f'#tree [data-address="{address}"]')

    def value(self, name):
        return self.browser.text(f'#detail [data-property="{name}"] .mi-value')

    def test_lists_every_node_in_mihosts_order(self):
        expected = [row['address'] for row in rows('tree')]
        self.assertEqual(self.addresses(), [each for each in expected if not each.startswith('log:')])
        self.browser.click('#tree [data-address=log] .mi-tree__toggle')
        until(lambda: len(self.addresses()) == len(expected), 'the log does not open')
        self.assertEqual(self.addresses(), expected)

    def test_search_keeps_what_matches_and_its_parents(self):
        self.browser.type('#tree-search', 'CARL')
        self.listed('mi', 'root', 'computer', 'os', 'user:carl', 'group:team')
        self.browser.type('#tree-search', 'nobody')
        self.listed()
        self.browser.see('#panel-tree', 'No node matches.')

    def test_kind_filter_keeps_the_nodes_of_one_kind(self):
        self.browser.click('#kind-filter option[value=group]')
        until(lambda: 'user:anna' not in self.addresses(), 'users stay')
        groups = [each for each in self.addresses() if each.startswith('group:')]
        self.assertEqual(groups, ['group:root', 'group:anna', 'group:ben', 'group:team'])

    def test_shows_a_node_with_names_units_and_meanings(self):
        self.choose('user:carl')
        self.browser.see('#detail', 'user:carl', 'Carl Example')
        for row in rows('get', 'user:carl'):
            with self.subTest(row['name']):
                shown = self.browser.text(f'#detail [data-property="{row["name"]}"]')
                self.assertIn(row['name'], shown)
                self.assertIn(row['id'], shown)
        self.assertEqual(self.value('user-id'), '1002')
        self.browser.see('#detail [data-property=password-min-days]', '1 day')
        self.choose('os')
        self.browser.see('#detail [data-property=os-name]', "first line of the distribution's release file")
        self.browser.see('#detail [data-property=physical-memory-size]', 'KiB')

    def test_figures_change_in_place(self):
        self.browser.see('#detail [data-property=process-count]', 'processes')
        row = self.browser.find('#detail [data-property=process-count]')[0]
        before = int(self.value('process-count'))
        more = [subprocess.Popen(['sleep', '1000']) for _ in range(40)]
        try:
            # The kernel counts the processes of the whole machine, and others may end meanwhile.
            until(lambda: int(self.value('process-count')) != before, 'the figure stays')
        finally:
            for process in more:
                process.kill()
                process.wait()
        self.assertTrue(row.is_displayed())  # the same element

    def test_keyboard_moves_through_the_nodes(self):
        self.browser.tab_to('#tree')
        self.browser.press(Keys.HOME, Keys.ARROW_DOWN, Keys.ARROW_DOWN)
        self.browser.press(Keys.ENTER)
        self.browser.see('#detail', 'computer')
        self.browser.press(Keys.ARROW_LEFT)
        self.listed('mi', 'root', 'computer')
        self.browser.press(Keys.ARROW_RIGHT, Keys.END, Keys.ARROW_RIGHT, Keys.END, Keys.ENTER)
        self.browser.see('#detail', 'mole test: one')  # the oldest is the last

    def test_address_of_the_page_names_the_node(self):
        self.choose('user:ben')
        self.browser.see('#detail', 'user:ben')
        self.assertTrue(self.browser.driver.current_url.endswith('#/tree/user%3Aben'), self.browser.driver.current_url)
        self.browser.driver.back()
        self.browser.see('#detail', 'the operating system')


def setUpModule():
    cockpit.install_cockpit()


if __name__ == '__main__':
    cockpit.main()
