#!/usr/bin/python

from __future__ import absolute_import, division, print_function

__metaclass__ = type

DOCUMENTATION = r'''
module: mi_user
short_description: Manage a local user account
description:
  - Brings an ordinary local account to a desired state. Options that are not given are not changed.
  - In check mode the change runs in a sandbox on the target, so errors of C(useradd)
    show beforehand.
version_added: 1.0.0
author:
  - The mihost developers (!UNKNOWN)
options:
  name:
    description:
      - The login name.
    type: str
    required: true
  state:
    description:
      - Whether the account should exist. The home directory of a deleted account is kept.
    type: str
    choices: [present, absent]
    default: present
  full_name:
    description:
      - The comment field of the account.
    type: str
  home:
    description:
      - The home directory, created with a new account, otherwise moved with its files.
      - Without this option a new account has the target's default home directory, which is only created
        if the target is configured so.
    type: str
  shell:
    description:
      - The login shell.
    type: str
  password:
    description:
      - The password hash, as in the shadow file, or C(!) or C(*) for none.
      - It is passed to the target on standard input only.
    type: str
  password_min_days:
    description:
      - The minimum password age in days.
    type: int
  password_max_days:
    description:
      - The maximum password age in days, 99999 for no limit.
    type: int
  password_warn_days:
    description:
      - How many days before the password expires the user is warned.
    type: int
  inactive_days:
    description:
      - How many days after the password's expiry the account stays active, 99999 for no limit.
    type: int
  expires:
    description:
      - The day on which the account expires, as C(YYYY-MM-DD), or C(never).
    type: str
extends_documentation_fragment:
  - mi.host.mihost
  - mi.host.mihost.change
notes:
  - For an account whose UID is outside the range of ordinary ones the task fails.
seealso:
  - module: mi.host.mi_group
  - module: ansible.builtin.user
'''

EXAMPLES = r'''
- name: Create an account, or bring it to this state
  mi.host.mi_user:
    name: jdoe
    full_name: J. Doe
    shell: /bin/bash
    password: "{{ vault_password | password_hash('sha512', vault_salt) }}"
    password_max_days: 90
    expires: 2030-12-31
  become: true

- name: Delete an account
  mi.host.mi_user:
    name: jdoe
    state: absent
  become: true
'''

RETURN = r'''
changed:
  description: Whether the target changed, or would change in check mode.
  returned: always
  type: bool
changes:
  description: The account files that changed, in check mode all files.
  returned: always
  type: list
  elements: dict
  sample:
    - {file: /etc/group, change: changed, kind: file, removed: [], added: ['crew:x:1001:']}
commands:
  description: The commands that ran in the sandbox, and their output.
  returned: in check mode
  type: list
  elements: dict
  sample:
    - {command: /usr/sbin/groupadd crew 2>&1, output: ''}
rc:
  description: The exit status of mihost.
  returned: on failure
  type: int
  sample: 1
reason:
  description:
    - C(failed) if the change failed, C(refused) if mihost refused the input, C(no plug-in) if the
      plug-in could not be loaded, C(not found) if there is no such node or property.
  returned: on failure
  type: str
  sample: refused
'''

import pwd
import re
import time

from ansible.module_utils.basic import AnsibleModule
from ansible_collections.mi.host.plugins.module_utils.mihost import (
    CHANGE_OPTIONS,
    Mihost,
    script_line,
)
from ansible_collections.mi.host.plugins.module_utils.nodes import values_of

# Option, property of the node, parameter of UserAdd, and the method that changes it with its parameter.
TEXTS = (
    ('full_name', 'full_name', 'Comment', 'UserSetFullName', 'FullName'),
    ('home', 'home_directory', 'HomeDir', 'UserSetHomeDir', 'HomeDir'),
    ('shell', 'login_shell', 'ScriptPath', 'UserSetScriptPath', 'ScriptPath'),
)

# Option, property of the node, and the parameter of UserAdd and UserSetAttrib.
AGES = (
    ('password_min_days', 'password_min_days', 'daysMustKeepPassword'),
    ('password_max_days', 'password_max_days', 'daysMustChangePasswordAfter'),
    ('password_warn_days', 'password_warn_days', 'daysWarnBeforePasswordExpire'),
    ('inactive_days', 'password_expiry_days', 'daysExpireAfter'),
)

NEVER = 'never'
# Contract: the day that an account without an expiry reports.
DAY_OF_NEVER = '2038-01-19'


def call(method, parameters, confirmed=False):
    words = ['call', method] + ['%s=%s' % parameter for parameter in parameters]
    return script_line(words, confirmed)


def expiry_of(values):
    """The day of the account's expiry in the form of the option; None if unknown."""
    if values['inactive_time'] is None:
        return None
    day = time.strftime('%Y-%m-%d', time.localtime(values['inactive_time']))
    return NEVER if day == DAY_OF_NEVER else day


def to_make(wanted):
    """The commands that create an account."""
    name = wanted['name']
    parameters = [('UserName', name)]
    parameters += [(row[2], wanted[row[0]]) for row in TEXTS + AGES if wanted[row[0]] is not None]
    if wanted['expires'] not in (None, NEVER):
        parameters.append(('passwordExpirationDate', wanted['expires']))
    lines = [call('UserAdd', parameters)]
    if wanted['password'] is not None:
        lines.append(script_line(['set', 'user:' + name, 'password', wanted['password']]))
    return lines


def same_text(option, wanted, present):
    """Newer tools store a home directory without the slash at its end."""
    if option == 'home' and len(wanted) > 1:
        wanted = wanted.rstrip('/')
    return wanted == present


def to_age(wanted, values):
    """The command that sets the ageing and the expiry, if they differ."""
    expiry = expiry_of(values)
    parameters = [
        (parameter, wanted[option])
        for option, key, parameter in AGES
        if wanted[option] is not None and wanted[option] != values[key]
    ]
    if not parameters and wanted['expires'] in (None, expiry):
        return []
    # Without a date the method erases the expiry.
    day = expiry if wanted['expires'] is None else wanted['expires']
    if day not in (None, NEVER):
        parameters.append(('passwordExpirationDate', day))
    return [call('UserSetAttrib', [('UserName', wanted['name'])] + parameters,
                 confirmed=wanted['expires'] == NEVER)]


def to_adapt(wanted, values):
    """The commands that bring an account to the desired state."""
    name = wanted['name']
    lines = []
    for option, key, dummy, method, parameter in TEXTS:
        value = wanted[option]
        if value is not None and not same_text(option, value, values[key]):
            lines.append(call(method, [('UserName', name), (parameter, value)]))
    lines += to_age(wanted, values)
    if wanted['password'] not in (None, values['password']):
        lines.append(script_line(['set', 'user:' + name, 'password', wanted['password']]))
    return lines


def exists_elsewhere(name):
    """Whether the account exists although the tree does not show it."""
    try:
        pwd.getpwnam(name)
    except KeyError:
        return False
    return True


def main():
    module = AnsibleModule(
        argument_spec=dict(
            CHANGE_OPTIONS,
            name=dict(type='str', required=True),
            state=dict(type='str', choices=['present', 'absent'], default='present'),
            full_name=dict(type='str'),
            home=dict(type='str'),
            shell=dict(type='str'),
            password=dict(type='str', no_log=True),
            password_min_days=dict(type='int', no_log=False),
            password_max_days=dict(type='int', no_log=False),
            password_warn_days=dict(type='int', no_log=False),
            inactive_days=dict(type='int'),
            expires=dict(type='str'),
        ),
        supports_check_mode=True,
    )
    wanted = module.params
    name = wanted['name']
    if wanted['expires'] not in (None, NEVER) and not re.match(r'\d{4}-\d\d-\d\d$', wanted['expires']):
        module.fail_json(msg='expires: a day is written as YYYY-MM-DD, or never', rc=2, reason='refused')
    mihost = Mihost(module)
    node = mihost.find('user:' + name)
    if node is None and exists_elsewhere(name):
        module.fail_json(msg='%s is not an ordinary local account' % name, rc=2, reason='refused')
    if wanted['state'] == 'absent':
        lines = [call('UserDel', [('UserName', name)])] if node else []
    else:
        lines = to_adapt(wanted, values_of(node)) if node else to_make(wanted)
    module.exit_json(**mihost.change(lines))


if __name__ == '__main__':
    main()
