#!/usr/bin/env python3
"""A web server for tests: each path is a behaviour. Prints "PLAIN SECURE", its ports on 127.0.0.1.

Usage: web_server.py CERTIFICATE KEY
"""
import email.utils
import http.server
import socket
import ssl
import struct
import sys
import threading
import time
import urllib.parse

API = b'{"captive": true, "user-portal-url": "https://portal.example/"}'
DESCRIPTION = b"""<?xml version="1.0"?><root><device><manufacturer>Example Networks</manufacturer>
<modelName>Base 5</modelName><serviceList><service>
<serviceType>urn:schemas-upnp-org:service:WANIPConnection:1</serviceType>
<controlURL>/control</controlURL></service></serviceList></device></root>"""
SOAP = b"<e><b><NewExternalIPAddress>10.20.30.40</NewExternalIPAddress></b></e>"
forever = threading.Event()


class Handler(http.server.BaseHTTPRequestHandler):
    protocol_version = "HTTP/1.1"
    disable_nagle_algorithm = True  # what was written is on its way before a reset

    def answer(self, status, body=b"", **headers):
        self.send_response(status)
        for name, value in headers.items():
            self.send_header(name, value)
        if status != 204:
            self.send_header("Content-Length", str(len(body)))
        self.end_headers()
        self.wfile.write(body)

    def do_GET(self):
        path = self.path
        if path == "/204":
            self.answer(204)
        elif path == "/yesterday":
            self.send_response_only(204)
            self.send_header("Date", email.utils.formatdate(time.time() - 86400 - 60, usegmt=True))
            self.end_headers()
        elif path == "/empty":
            self.answer(200)
        elif path == "/page":
            self.answer(200, b"<html>please log in</html>")
        elif path == "/chunks":
            self.send_response(200)
            self.send_header("Transfer-Encoding", "chunked")
            self.end_headers()
            self.wfile.write(b"6;x=y\r\n<html>\r\n14\r\nplease log in</html>\r\n0\r\nTrailer: x\r\n\r\n")
        elif path == "/until-closed":
            self.send_response(200)
            self.end_headers()
            self.wfile.write(b"<html>please log in</html>")
            self.close_connection = True
            if isinstance(self.connection, ssl.SSLSocket):
                self.connection.unwrap()
        elif path.startswith("/until-reset/"):
            self.wfile.write(b"HTTP/1.1 200 OK\r\n\r\n" + path.removeprefix("/until-reset/").encode())
            self.reset()
        elif path.startswith("/until-cut/"):
            self.wfile.write(b"HTTP/1.1 200 OK\r\n\r\n" + path.removeprefix("/until-cut/").encode())
            self.cut()
        elif path == "/page-and-cut":
            self.answer(200, b"<html>please log in</html>")
            self.cut()
        elif path == "/other-protocol":
            self.wfile.write(b"220 mail.example ESMTP\r\n")
            self.close_connection = True
        elif path == "/redirect":
            self.answer(302, Location="/login")
        elif path == "/nowhere":
            self.answer(302)
        elif path.startswith("/redirect-to/"):
            self.answer(302, Location=urllib.parse.unquote(path.removeprefix("/redirect-to/")))
        elif path == "/redirect-and-hang":
            self.wfile.write(b"HTTP/1.1 302 Found\r\nLocation: /login\r\nContent-Length: 500\r\n\r\n")
            forever.wait()
        elif path == "/page-and-hang":
            self.wfile.write(b"HTTP/1.1 200 OK\r\nContent-Length: 500\r\n\r\n<html>")
            forever.wait()
        elif path == "/page-that-never-comes":
            self.wfile.write(b"HTTP/1.1 200 OK\r\nContent-Length: 500\r\n\r\n")
            self.close_connection = True
        elif path == "/chunks-that-never-come":
            self.wfile.write(b"HTTP/1.1 200 OK\r\nTransfer-Encoding: chunked\r\n\r\n")
            self.close_connection = True
        elif path == "/endless-page":
            self.wfile.write(b"HTTP/1.1 200 OK\r\n\r\n")
            while True:
                self.wfile.write(b"<p>please wait</p>" * 100)
        elif path == "/endless":
            self.wfile.write(b"HTTP/1.1 200 OK\r\nTransfer-Encoding: chunked\r\n\r\n")
            while True:
                self.wfile.write((b"1;" + b"x" * 240 + b"\r\na\r\n") * 100)
        elif path == "/511":
            self.answer(511, b"log in")
        elif path == "/big":
            self.answer(200, b"x" * 300000)
        elif path == "/echo":
            self.answer(200, (self.headers.get("Accept", "") + "|" + self.headers.get("Host", "")).encode())
        elif path == "/api":
            self.answer(200, API, **{"Content-Type": "application/captive+json"})
        elif path == "/description.xml":
            self.answer(200, DESCRIPTION)
        elif path.startswith("/control-at/"):
            self.answer(200, DESCRIPTION.replace(b"/control<", path.removeprefix("/control-at/").encode() + b"<"))
        elif path == "/drop":
            self.wfile.write(b"HTTP/1.1 2")
            self.close_connection = True
        elif path == "/hang":
            forever.wait()
        else:
            self.answer(404)

    def reset(self):
        self.connection.setsockopt(socket.SOL_SOCKET, socket.SO_LINGER, struct.pack("ii", 1, 0))
        self.cut()

    def cut(self):
        """Ends the connection without a word, where it is a secure one."""
        self.close_connection = True
        with socket.socket(fileno=self.connection.detach()):
            pass

    def do_POST(self):
        body = self.rfile.read(int(self.headers.get("Content-Length", 0)))
        good = b"GetExternalIPAddress" in body and "GetExternalIPAddress" in self.headers.get("SOAPAction", "")
        self.answer(200 if good else 500, SOAP if good else b"")

    def log_message(self, *_):
        pass


class Server(http.server.ThreadingHTTPServer):
    def handle_error(self, *_):
        pass  # clients that break off are what the tests are about


def serve(server):
    server.daemon_threads = True
    threading.Thread(target=server.serve_forever, daemon=True).start()
    return server.server_address[1]


plain = Server(("127.0.0.1", 0), Handler)
secure = Server(("127.0.0.1", 0), Handler)
context = ssl.SSLContext(ssl.PROTOCOL_TLS_SERVER)
context.load_cert_chain(sys.argv[1], sys.argv[2])
secure.socket = context.wrap_socket(secure.socket, server_side=True, do_handshake_on_connect=False)
print(serve(plain), serve(secure), flush=True)
forever.wait()
