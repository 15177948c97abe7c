"""Lists the data of the plug-in's user and group nodes with the modules pwd, spwd and grp, and prints
the time in milliseconds without the start of the interpreter."""

import time
import warnings

warnings.simplefilter("ignore")
import grp
import pwd
import spwd


def bounds(kind):
    found = {"MIN": 1000, "MAX": 60000}
    with open("/etc/login.defs") as lines:
        for line in lines:
            words = line.split()
            if len(words) > 1 and words[0].startswith(kind + "_") and words[0][4:] in found:
                found[words[0][4:]] = int(words[1])
    return found["MIN"], found["MAX"]


def login_failures():
    failures = 0
    try:
        with open("/etc/pam.d/login") as rules:
            for line in rules:
                if "deny=" in line:
                    failures = int(line.split("deny=", 1)[1].split()[0])
    except (OSError, ValueError):
        pass
    return failures


def seconds(base, days):
    return base + days * 86400


def users(accounts):
    lowest, highest = bounds("UID")
    shadow = {entry.sp_namp: entry for entry in spwd.getspall()}
    failures = login_failures()
    base = time.mktime((1970, 1, 1, 0, 0, 0, 0, 0, -1))
    never = time.mktime((2038, 1, 19, 0, 0, 0, 0, 0, -1))
    found = []
    for account in accounts:
        if account.pw_uid != 0 and not lowest <= account.pw_uid <= highest:
            continue
        user = {
            "name": account.pw_name,
            "name-length": len(account.pw_name),
            "id": str(account.pw_uid),
            "id-length": len(str(account.pw_uid)),
            "group-id": str(account.pw_gid),
            "full-name": account.pw_gecos,
            "home": account.pw_dir,
            "shell": account.pw_shell,
            "failures": failures,
        }
        entry = shadow.get(account.pw_name)
        if entry:
            user["password"] = entry.sp_pwdp
            user["password-length"] = len(entry.sp_pwdp)
            user["max-days"] = entry.sp_max
            user["warn-days"] = entry.sp_warn
            user["min-days"] = entry.sp_min
            user["inactive-days"] = entry.sp_inact
            user["last-change"] = seconds(base, entry.sp_lstchg)
            user["expires"] = never if entry.sp_expire == -1 else seconds(base, entry.sp_expire)
        found.append(user)
    return found


def groups(accounts):
    lowest, highest = bounds("GID")
    primary = {}
    for account in accounts:
        primary.setdefault(account.pw_gid, []).append(account.pw_name)
    found = []
    for group in grp.getgrall():
        if group.gr_gid != 0 and not lowest <= group.gr_gid <= highest:
            continue
        members = dict.fromkeys(primary.get(group.gr_gid, []))
        members.update(dict.fromkeys(group.gr_mem))
        found.append({"name": group.gr_name, "id": group.gr_gid, "members": list(members)})
    return found


start = time.perf_counter()
everybody = pwd.getpwall()
listed = users(everybody), groups(everybody)
print((time.perf_counter() - start) * 1000)
