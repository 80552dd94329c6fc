# SPDX-License-Identifier: Apache-2.0
"""Takes out of a text what says whose machine it is from: names of users and hosts,
paths of theirs, addresses, and secrets of the environment."""

import ipaddress
import os
import pwd
import re
import socket
import subprocess

# Names that say nothing of anybody, and that ordinary sentences have.
COMMON = {"root", "user", "debian", "localhost", "build", "builder", "nobody", "test", "orv",
          "developer", "admin", "java", "home", "linux", "video", "audio", "docker", "runner"}
SECRET = re.compile(r"TOKEN|SECRET|PASS|KEY|CREDENTIAL|AUTH|COOKIE|PRIVATE|SIGNATURE", re.I)
SHORTEST_SECRET = 4
# Values that such variables may have and that are no secrets.
PLAIN = {"true", "false", "none", "null", "auto", "always", "never", "default"}
# Named hosts outside of URLs: the endings that hosts have and files do not.
ENDINGS = "arpa|biz|com|corp|de|edu|example|fr|gov|home|info|internal|intranet|jp|kr|lan|local|" \
    "localdomain|net|org|tv|uk|cn|tw"

PATTERNS = [
    (re.compile(r"\b([a-z][a-z0-9+.-]*://)(?:[^\s/@]*@)?[^\s/:'\"<>)\]]+(?::\d+)?", re.I),
     r"\1HOST"),
    (re.compile(r"[\w.+-]+@[\w-]+(?:\.[\w-]+)*"), "MAIL"),
    (re.compile(r"\b(Bearer|Basic) +[\w.~+/=-]{8,}", re.I), r"\1 SECRET"),
    (re.compile(r"((?:token|secret|passw(?:or)?d|passphrase|api[-_]?key|credentials?)[\"']?"
                r" *[=:] *[\"']?)[^\s\"'&,;]+", re.I), r"\1SECRET"),
    (re.compile(r"\b[0-9a-f]{2}(?:[:-][0-9a-f]{2}){5}\b", re.I), "ADDRESS"),
    (re.compile(r"(?<![\w.])\d{1,3}(?:\.\d{1,3}){3}(?![\w.]*\w)"), "ADDRESS"),
    (re.compile(rf"(?<![\w./-])[\w-]+(?:\.[\w-]+)*\.(?:{ENDINGS})(?![\w.-]*\w)", re.I), "HOST"),
    (re.compile(r"/(home|Users|run/user|media)/[^/\s'\":;,)\]]+"), r"/\1/USER"),
]
POSSIBLY_IPV6 = re.compile(r"(?<![\w:.])[0-9a-f:]*:[0-9a-f:.]*:[0-9a-f:.]*(?![\w:])", re.I)


class Anonymous:
    """Knows this machine's names; folders goes from what stands for a path to it."""

    def __init__(self, folders):
        self.paths = sorted(((os.path.realpath(path), word) for word, path in folders.items()),
                            key=lambda pair: -len(pair[0]))
        self.paths += [(path, word) for word, path in folders.items()]
        homes = {os.environ.get("HOME", ""), pwd_home()} - {"", "/"}
        self.paths += [(home, "~") for home in homes]
        self.secrets = sorted((value for name, value in os.environ.items()
                               if SECRET.search(name) and len(value) >= SHORTEST_SECRET
                               and value.lower() not in PLAIN),
                              key=len, reverse=True)
        self.names = {**dict.fromkeys(host_names(), "HOST"), **dict.fromkeys(user_names(), "USER")}

    def text(self, text):
        for secret in self.secrets:
            text = text.replace(secret, "SECRET")
        for path, word in self.paths:
            text = re.sub(rf"(?<![\w/.-]){re.escape(path)}(?![\w-])", word, text)
        for pattern, replacement in PATTERNS:
            text = pattern.sub(replacement, text)
        text = POSSIBLY_IPV6.sub(without_ipv6, text)
        for name in sorted(self.names, key=len, reverse=True):
            text = re.sub(rf"(?<![^\W_]){re.escape(name)}(?![^\W_])", self.names[name], text,
                          flags=re.I)
        return text


def without_ipv6(match):
    try:
        ipaddress.IPv6Address(match[0])
    except ValueError:
        return match[0]
    return match[0] if match[0] == "::" else "ADDRESS"


def pwd_home():
    try:
        return pwd.getpwuid(os.getuid()).pw_dir
    except KeyError:
        return ""


def user_names():
    """Names of who runs this, for the system, for people and for git."""
    found = {os.environ.get(name, "") for name in ("USER", "LOGNAME", "SUDO_USER", "USERNAME")}
    found.add(os.path.basename(os.environ.get("HOME", "").rstrip("/")))
    for number in (os.getuid(), os.environ.get("SUDO_UID", "")):
        try:
            entry = pwd.getpwuid(int(number))
        except (KeyError, ValueError, OverflowError):
            continue
        found |= {entry.pw_name, entry.pw_gecos.split(",")[0]}
    found.add(said_by("git", "config", "user.name"))
    return personal(found)


def host_names():
    found = {socket.gethostname(), os.environ.get("HOSTNAME", ""), os.environ.get("HOST", "")}
    for path in ("/etc/hostname", "/etc/mailname"):
        try:
            with open(path, encoding="utf-8", errors="replace") as file:
                found.add(file.read().strip())
        except OSError:
            pass
    found |= {name.split(".")[0] for name in found}
    return personal(found)


def personal(names):
    return {name for name in names if len(name) > 1 and name.lower() not in COMMON}


def said_by(*command):
    try:
        return subprocess.run(command, capture_output=True, text=True, errors="replace",
                              check=False).stdout.strip()
    except OSError:
        return ""
