#!/usr/bin/python

from __future__ import absolute_import, division, print_function

__metaclass__ = type

DOCUMENTATION = r'''
module: mi_group
short_description: Manage a local group and its members
description:
  - Brings an ordinary local group to a desired state.
  - In check mode the change runs in a sandbox on the target, so errors of C(groupadd)
    show beforehand.
version_added: 1.0.0
author:
  - The mihost developers (!UNKNOWN)
options:
  name:
    description:
      - The name of the group.
    type: str
    required: true
  state:
    description:
      - Whether the group should exist.
    type: str
    choices: [present, absent]
    default: present
  members:
    description:
      - Login names of the members. If it is not given, they are not changed.
      - Accounts with this primary group are always members.
    type: list
    elements: str
  append:
    description:
      - Whether to keep members that are not in I(members).
    type: bool
    default: false
extends_documentation_fragment:
  - mi.host.mihost
  - mi.host.mihost.change
notes:
  - For a group whose GID is outside the range of ordinary ones the task fails.
seealso:
  - module: mi.host.mi_user
  - module: ansible.builtin.group
'''

EXAMPLES = r'''
- name: Create a group of two
  mi.host.mi_group:
    name: crew
    members: [jdoe, dora]
  become: true

- name: Delete a group
  mi.host.mi_group:
    name: crew
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

import grp
import pwd

from ansible.module_utils.basic import AnsibleModule
from ansible_collections.mi.host.plugins.module_utils.mihost import (
    CHANGE_OPTIONS,
    Mihost,
    script_line,
)
from ansible_collections.mi.host.plugins.module_utils.nodes import values_of


def call(method, *parameters):
    return script_line(['call', method] + ['%s=%s' % parameter for parameter in parameters])


def membership(method, group, member):
    return call(method, ('LocalGroupName', group), ('DomainAndMember', member))


def is_primary(member, gid):
    """Whether the account is a member by its primary group, which no membership change ends."""
    try:
        return pwd.getpwnam(member).pw_gid == gid
    except KeyError:
        return False


def to_adapt(wanted, values):
    """The commands that bring the members to the desired state."""
    group = wanted['name']
    if wanted['members'] is None:
        return []
    members = values['members'] or []
    lines = [
        membership('LocalGroupAddUser', group, member)
        for member in wanted['members']
        if member not in members
    ]
    if not wanted['append']:
        lines += [
            membership('LocalGroupDelUser', group, member)
            for member in members
            if member not in wanted['members'] and not is_primary(member, values['group_id'])
        ]
    return lines


def to_make(wanted):
    lines = [call('LocalGroupAdd', ('GroupName', wanted['name']))]
    return lines + to_adapt(wanted, dict(members=[], group_id=None))


def exists_elsewhere(name):
    """Whether the group exists although the tree does not show it."""
    try:
        grp.getgrnam(name)
    except KeyError:
        return False
    return True


def main():
    module = AnsibleModule(
        argument_spec=dict(
            CHANGE_OPTIONS,
            name=dict(type='str', required=True),
            state=dict(type='str', choices=['present', 'absent'], default='present'),
            members=dict(type='list', elements='str'),
            append=dict(type='bool', default=False),
        ),
        supports_check_mode=True,
    )
    wanted = module.params
    name = wanted['name']
    mihost = Mihost(module)
    node = mihost.find('group:' + name)
    if node is None and exists_elsewhere(name):
        module.fail_json(msg='%s is not an ordinary local group' % name, rc=2, reason='refused')
    if wanted['state'] == 'absent':
        lines = [call('LocalGroupDel', ('GroupName', name))] if node else []
    else:
        lines = to_adapt(wanted, values_of(node)) if node else to_make(wanted)
    module.exit_json(**mihost.change(lines))


if __name__ == '__main__':
    main()
