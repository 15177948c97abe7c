#!/usr/bin/python

from __future__ import absolute_import, division, print_function

__metaclass__ = type

DOCUMENTATION = r'''
module: mi_info
short_description: Read the management tree of a machine
description:
  - Returns the operating system, its kernel modules, local users and groups, and the newest lines of
    the system log, as native types keyed by name.
version_added: 1.0.0
author:
  - The mihost developers (!UNKNOWN)
options:
  kind:
    description:
      - What to read, C(tree) for everything.
    type: str
    choices: [tree, computer, os, drivers, users, groups, log]
    default: tree
  facts:
    description:
      - Whether to set the result as the fact C(mi) of the host.
    type: bool
    default: false
extends_documentation_fragment:
  - mi.host.mihost
attributes:
  check_mode:
    description: Nothing is changed.
    support: full
  diff_mode:
    description: Nothing is changed.
    support: none
notes:
  - Without root on the target the passwords and ageing of users are null.
  - Password hashes are never returned.
seealso:
  - module: ansible.builtin.setup
'''

EXAMPLES = r'''
- name: Read everything into the fact mi
  mi.host.mi_info:
    facts: true
  become: true

- name: Show who has bash as login shell
  ansible.builtin.debug:
    msg: "{{ ansible_facts.mi.users.values() | selectattr('login_shell', '==', '/bin/bash')
          | map(attribute='user_name') }}"

- name: Read the operating system only
  mi.host.mi_info:
    kind: os
  register: result
'''

RETURN = r'''
mi:
  description:
    - The nodes. C(computer) and C(os) are one dictionary each; C(drivers), C(users) and C(groups)
      have one for each name; C(log) is a list of entries, the newest first.
    - The keys are the names of the properties with underscores, see C(mihost properties). Dates are
      seconds since 1970, and values that could not be read are null.
  returned: if I(facts=false)
  type: dict
  sample:
    os: {os_name: Linux, physical_memory_size: 24684472, last_boot_time: 1763740800}
    users:
      root: {user_name: root, user_id: "0", login_shell: /bin/bash}
ansible_facts:
  description: C(mi) as a fact.
  returned: if I(facts=true)
  type: dict
  sample: {mi: {os: {os_name: Linux}}}
'''

from ansible.module_utils.basic import AnsibleModule
from ansible_collections.mi.host.plugins.module_utils.mihost import READ_OPTIONS, Mihost
from ansible_collections.mi.host.plugins.module_utils.nodes import SINGLE, native


def main():
    module = AnsibleModule(
        argument_spec=dict(
            READ_OPTIONS,
            kind=dict(
                type='str',
                choices=['tree', 'computer', 'os', 'drivers', 'users', 'groups', 'log'],
                default='tree',
            ),
            facts=dict(type='bool', default=False),
        ),
        supports_check_mode=True,
    )
    mihost = Mihost(module)
    kind = module.params['kind']
    if kind == 'tree':
        nodes = mihost.read('tree')
    elif kind in SINGLE:
        nodes = [mihost.read('get', kind)]
    else:
        nodes = mihost.read('list', kind)
    result = dict(mi=native(nodes))
    if module.params['facts']:
        result = dict(ansible_facts=result)
    module.exit_json(changed=False, **result)


if __name__ == '__main__':
    main()
