# Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

"""What the servers of the trial need for TLS and sign-in."""

import os
import secrets
import subprocess

USER = "prometheus"
# The name in the certificate, which all machines share.
HOST = "fleet.example.com"


def make(folder):
    """Makes a certificate and a password in the folder, under the names of the configuration."""
    mask = os.umask(0o077)
    try:
        password = secrets.token_urlsafe()
        (folder / "password").write_text(password)
        hashed = openssl("passwd", "-6", "-stdin", input=password)
        (folder / "passwords.pem").write_text(f"{USER}:{hashed}")
        openssl(
            *("req", "-x509", "-newkey", "ec", "-pkeyopt", "ec_paramgen_curve:P-256", "-nodes"),
            *("-days", "30", "-subj", f"/CN={HOST}", "-addext", f"subjectAltName=DNS:{HOST}"),
            *("-keyout", folder / "key.pem", "-out", folder / "certificate.pem"),
        )
        (folder / "ca.pem").write_bytes((folder / "certificate.pem").read_bytes())
    finally:
        os.umask(mask)


def openssl(*arguments, **options):
    command = ("openssl", *arguments)
    return subprocess.run(command, check=True, text=True, capture_output=True, **options).stdout
