"""Users, groups, drivers, the log, the checks and the figures as the page shows them."""

import json
import subprocess

from support import cockpit, environment, machine
from support.cockpit import PageTest
from support.wait import until


class Views(PageTest):
    def names(self, table):
        """Returns the names in the first column, from top to bottom."""
        return self.browser.attributes(f'{table} tr[data-name]', 'data-name')

    def listed(self, table, *names):
        until(lambda: self.names(table) == list(names), lambda: f'{table}: {self.names(table)}')

    def test_users_are_sorted_by_any_column(self):
        self.browser.open('users')
        self.listed('#users-table', 'anna', 'ben', 'carl', 'root')
        self.browser.click('#users-table th:nth-child(1) button')
        self.listed('#users-table', 'root', 'carl', 'ben', 'anna')
        self.browser.button('Warned days', '#users-table')  # by number: 7 before 14
        self.listed('#users-table', 'root', 'anna', 'ben', 'carl')
        self.assertEqual(self.browser.attributes('#users-table th:nth-child(7)', 'aria-sort')[0], 'ascending')

    def test_users_have_their_ageing(self):
        self.browser.open('users')
        # Day 14000 since 1970 for the password, and day 15000 for the account.
        anna = ('1000', 'Anna,,,', '/bin/bash', '2008-05-01', '90', '14', '30', '2011-01-26')
        self.browser.see('#users-table tr[data-name=anna]', *anna)
        self.browser.see('#users-table tr[data-name=root]', 'no limit', 'never')

    def test_users_are_filtered_by_any_column(self):
        self.browser.open('users')
        self.listed('#users-table', 'anna', 'ben', 'carl', 'root')
        self.browser.type('#users-filter', '/bin/sh')
        self.listed('#users-table', 'carl')
        self.browser.type('#users-filter', '1001')
        self.listed('#users-table', 'ben')
        self.browser.type('#users-filter', 'nobody')
        self.listed('#users-table')
        self.browser.see('#panel-users', '0 of 4')

    def test_account_has_groups_dates_and_state(self):
        self.browser.open('users')
        self.browser.button('carl', '#users-table')
        self.browser.see('#account', 'Carl Example', '/home/carl', 'team', 'expired', '2011-01-26', '2008-05-01')
        self.browser.button('team', '#account')
        self.browser.see('#group', '1500', 'anna', 'ben', 'carl')
        self.browser.button('ben', '#group')
        self.browser.see('#account', '/home/ben')
        self.browser.button('All users', '#account')
        self.listed('#users-table', 'anna', 'ben', 'carl', 'root')

    def test_account_has_the_id_of_a_missing_group(self):
        self.browser.open('users')
        self.browser.button('carl', '#users-table')
        self.browser.see('#account .mi-names', '100', 'primary', 'team')

    def test_groups_have_their_members(self):
        self.browser.open('groups')
        self.listed('#groups-table', 'anna', 'ben', 'root', 'team')
        self.browser.see('#groups-table tr[data-name=team]', '1500', '3: anna,ben,carl')

    def test_drivers_have_their_versions(self):
        self.browser.open('drivers')
        self.listed('#drivers-table', 'one', 'two')
        self.browser.see('#drivers-table tr[data-name=two]', '1.two')

    def test_reads_only_what_the_view_shows(self):
        self.browser.open('groups')
        self.listed('#groups-table', 'anna', 'ben', 'root', 'team')
        self.assertEqual([call for call in cockpit.calls() if 'list' in call],
                         ['-o csv list groups --columns group-name,group-id,members'])

    def test_checks_are_those_of_doctor(self):
        done = subprocess.run([environment.MIHOST, '--json', 'doctor'], capture_output=True, text=True)
        findings = json.loads(done.stdout)
        self.browser.open('doctor')
        self.browser.see('#doctor-findings', *(finding['need'] for finding in findings))
        self.assertEqual(len(self.browser.find('#doctor-findings li')), len(findings))
        self.assertEqual(
            len(self.browser.find('#doctor-findings li[data-outcome=ok]')), sum(finding['ok'] for finding in findings)
        )
        for finding in findings:
            if finding['fixable']:
                self.browser.see('#doctor-findings', finding['debian'])

    def test_figures_become_charts(self):
        self.browser.open('host')
        self.browser.see('.mi-chart[data-figure=physical-memory-used]', 'Memory in use', ' of ')
        self.browser.see('.mi-chart[data-figure=process-count]', 'processes')
        self.browser.wait('return document.querySelector(".mi-chart polyline").points.length > 1')


class Log(PageTest):
    def setUp(self):
        machine.write('/var/log/messages', machine.log_lines(['one', 'two', 'three']))
        self.browser.open('log')
        self.browser.see('#log-lines', 'one', 'two', 'three')

    def shown(self):
        return [line.rpartition(' ')[2] for line in self.browser.texts('.mi-log__line')]

    def add(self, *messages):
        with open('/var/log/messages', 'a') as log:
            log.write(machine.log_lines(messages))

    def test_filter_keeps_the_lines_that_match(self):
        self.browser.type('#log-filter', 'T')
        self.assertEqual(self.shown(), ['one', 'two', 'three'])  # "test:"
        self.browser.type('#log-filter', 'tw')
        self.assertEqual(self.shown(), ['two'])
        self.browser.type('#log-filter', 'four')
        self.browser.see('#panel-log', 'No line matches.')

    def test_follows_new_lines(self):
        self.add('four')
        self.browser.see('#log-lines', 'four')
        self.assertEqual(self.shown(), ['one', 'two', 'three', 'four'])

    def test_follows_only_while_switched_on(self):
        self.browser.click('#panel-log .pf-v6-c-switch')
        self.browser.wait('return document.querySelector("#panel-log [aria-busy]")?.ariaBusy !== "true"')
        until(lambda: self.shown() == ['one', 'two', 'three'], 'the lines are not read again')
        until(lambda: not cockpit.running('--follow'), 'mihost goes on')
        self.add('four')
        self.browser.click('#panel-log .pf-v6-c-switch')
        self.browser.see('#log-lines', 'four')

    def test_filter_applies_to_new_lines(self):
        self.browser.type('#log-filter', 'three')
        self.add('four', 'three-and-a-half')
        self.browser.see('#log-lines', 'three-and-a-half')
        self.assertEqual(self.shown(), ['three', 'three-and-a-half'])


def setUpModule():
    cockpit.install_cockpit()


if __name__ == '__main__':
    cockpit.main()
