#!/usr/bin/python

from __future__ import absolute_import, division, print_function

__metaclass__ = type

DOCUMENTATION = r'''
module: mi_call
short_description: Run one administration method
description:
  - Runs a method of the operating-system node, such as C(UserAdd).
  - A method runs each time; M(mi.host.mi_user) and M(mi.host.mi_group) take a desired state
    instead.
version_added: 1.0.0
author:
  - The mihost developers (!UNKNOWN)
options:
  method:
    description:
      - The method; C(mihost methods) lists all of them.
    type: str
    required: true
  parameters:
    description:
      - The parameters by name, without C(Password).
    type: dict
    default: {}
  password:
    description:
      - The parameter C(Password) of the method.
    type: str
  confirm:
    description:
      - Answers yes to the prompts of mihost, such as before deleting the account root, and lets
        C(UserSetAttrib) erase the expiry date of an account.
    type: bool
    default: false
extends_documentation_fragment:
  - mi.host.mihost
  - mi.host.mihost.change
seealso:
  - module: mi.host.mi_user
  - module: mi.host.mi_group
'''

EXAMPLES = r'''
- name: Create a group
  mi.host.mi_call:
    method: LocalGroupAdd
    parameters:
      GroupName: crew
  become: true

- name: Set a password
  mi.host.mi_call:
    method: UserSetPassword
    parameters:
      UserName: jdoe
    password: "{{ vault_password }}"
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


def main():
    module = AnsibleModule(
        argument_spec=dict(
            CHANGE_OPTIONS,
            method=dict(type='str', required=True),
            parameters=dict(type='dict', default={}),
            password=dict(type='str', no_log=True),
            confirm=dict(type='bool', default=False),
        ),
        supports_check_mode=True,
    )
    parameters = dict(module.params['parameters'])
    if 'Password' in parameters:
        module.fail_json(msg='Password is a secret, so it belongs into the option password')
    if module.params['password'] is not None:
        parameters['Password'] = module.params['password']
    words = ['call', module.params['method']]
    words += ['%s=%s' % (name, parameters[name]) for name in sorted(parameters)]
    line = script_line(words, module.params['confirm'])
    module.exit_json(**Mihost(module).change([line]))


if __name__ == '__main__':
    main()
