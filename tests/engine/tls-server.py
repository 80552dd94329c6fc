#!/usr/bin/python3
# SPDX-License-Identifier: Apache-2.0
"""Serves one file over TLS: tls-server.py FILE CERTIFICATE KEY

Writes its port as the first line, and ends with its standard input.
"""
import http.server
import ssl
import sys
import threading

PATH, CERTIFICATE, KEY = sys.argv[1:]


class Handler(http.server.BaseHTTPRequestHandler):
    def do_GET(self):
        with open(PATH, "rb") as file:
            content = file.read()
        self.send_response(200)
        self.send_header("Content-Length", str(len(content)))
        self.end_headers()
        self.wfile.write(content)

    def log_message(self, *_):
        pass


context = ssl.SSLContext(ssl.PROTOCOL_TLS_SERVER)
context.load_cert_chain(CERTIFICATE, KEY)
server = http.server.ThreadingHTTPServer(("127.0.0.1", 0), Handler)
# The handshake belongs to the connection's own thread.
server.socket = context.wrap_socket(server.socket, server_side=True, do_handshake_on_connect=False)
print(server.server_port, flush=True)
threading.Thread(target=server.serve_forever, daemon=True).start()
sys.stdin.read()
