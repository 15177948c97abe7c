from __future__ import absolute_import, division, print_function

__metaclass__ = type


class ModuleDocFragment(object):
    """Options and attributes that the modules share."""

    DOCUMENTATION = r'''
options:
  mihost:
    description:
      - The program on the target, as a name in the PATH or an absolute path.
    type: str
    default: mihost
requirements:
  - mihost on the target
'''

    CHANGE = r'''
options:
  lock_timeout:
    description:
      - How many seconds to wait while another mihost is changing the target.
      - The default is that of mihost, 60 seconds.
    type: int
attributes:
  check_mode:
    description:
      - The change really runs, in a sandbox on the target.
      - If a tool fails there, the task fails with its message.
      - Each task has its own sandbox, so a task that relies on an earlier task fails in check mode.
    support: full
  diff_mode:
    description: The lines of the files that change, with password hashes hidden.
    support: full
notes:
  - Changes need root on the target, as with C(become).
  - With C(pipelining = True) in the configuration each task takes one ssh round trip.
'''
