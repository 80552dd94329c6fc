# SPDX-License-Identifier: Apache-2.0
"""Checksums of a release's files, and their signature."""

import hashlib

from outcome import Missing, Skipped, output_of

SUMS = "SHA256SUMS"


def make_checksums(release):
    files = sorted(path for path in release.folder.rglob("*") if path.is_file())
    if not files:
        raise Skipped("no file was made")
    lines = [f"{digest(path)}  {path.relative_to(release.folder)}\n" for path in files]
    (release.folder / SUMS).write_text("".join(lines), "utf-8")
    return f"{SUMS} of {len(files)} files"


def digest(path):
    total = hashlib.sha256()
    with path.open("rb") as file:
        while block := file.read(1 << 20):
            total.update(block)
    return total.hexdigest()


def make_signature(release):
    """Detached, in text; the sums must be there. Asks for a passphrase if the key has one."""
    key = chosen_key(release)
    sums = release.folder / SUMS
    if not sums.exists():
        raise Skipped("there are no checksums to sign")
    signature = release.folder / f"{SUMS}.asc"
    output_of(["gpg", "--batch", "--yes", "--local-user", key, "--armor", "--detach-sign",
               "--output", signature, sums])
    output_of(["gpg", "--batch", "--verify", signature, sums])
    return f"{signature.name}, by the key {key}"


def chosen_key(release):
    """The fingerprint's key that signs: that of --key, or the first secret one."""
    wanted = [release.key] if release.key else []
    try:
        listed = output_of(["gpg", "--batch", "--with-colons", "--list-secret-keys", *wanted])
    except Missing as missing:
        if not wanted or "not installed" in str(missing):
            raise
        raise Missing(f"gpg has no secret key '{release.key}'") from None
    keys = [line.split(":")[4] for line in listed.splitlines() if line.startswith("sec:")]
    if not keys:
        raise Missing("gpg has no secret key to sign with")
    return keys[0]
