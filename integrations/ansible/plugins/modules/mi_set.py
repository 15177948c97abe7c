#!/usr/bin/python

from __future__ import absolute_import, division, print_function

__metaclass__ = type

DOCUMENTATION = r'''
module: mi_set
short_description: Write one property of a node
description:
  - Writes a property that acts on the machine, such as C(password) of a user.
  - A property that only changes in the memory of the plug-in changes nothing on the target; the task
    warns.
version_added: 1.0.0
author:
  - The mihost developers (!UNKNOWN)
options:
  node:
    description:
      - The node, such as C(os) or C(user:jdoe).
    type: str
    required: true
  property:
    description:
      - The property, as a name or an id; C(mihost properties) lists all of them.
    type: str
    required: true
  value:
    description:
      - The value; a date as C(YYYY-MM-DD).
    type: str
  secret:
    description:
      - The value of the properties C(password) and C(create-user), instead of I(value); never logged.
    type: str
  confirm:
    description:
      - Answers yes to the prompts of mihost, such as before restarting the machine.
    type: bool
    default: false
extends_documentation_fragment:
  - mi.host.mihost
  - mi.host.mihost.change
seealso:
  - module: mi.host.mi_user
'''

EXAMPLES = r'''
- name: Empty the system log
  mi.host.mi_set:
    node: os
    property: clear-log
    value: 9
    confirm: true
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

from ansible.module_utils.basic import AnsibleModule
from ansible_collections.mi.host.plugins.module_utils.mihost import (
    CHANGE_OPTIONS,
    Mihost,
    script_line,
)

# Properties that hold a password or its hash, by name and by id.
SECRET = ('password', '117', 'create-user', '74')


def main():
    module = AnsibleModule(
        argument_spec=dict(
            CHANGE_OPTIONS,
            node=dict(type='str', required=True),
            property=dict(type='str', required=True),
            value=dict(type='str'),
            secret=dict(type='str', no_log=True),
            confirm=dict(type='bool', default=False),
        ),
        mutually_exclusive=[('value', 'secret')],
        required_one_of=[('value', 'secret')],
        supports_check_mode=True,
    )
    name = module.params['property']
    value = module.params['value']
    if value is None:
        value = module.params['secret']
    elif name.lstrip('0') in SECRET:  # mihost reads an id with leading zeros
        module.fail_json(msg='%s holds a secret, so its value belongs into the option secret' % name)
    words = ['set', module.params['node'], name, value]
    line = script_line(words, module.params['confirm'])
    module.exit_json(**Mihost(module).change([line]))


if __name__ == '__main__':
    main()
