"""Passes bytes on to a port of this machine, and counts them."""
import socket
import threading


class CountingRelay:
    def __init__(self, port):
        self.target = port
        self.bytes = 0
        self.connections = 0
        self.listener = socket.create_server(("127.0.0.1", 0))
        self.port = self.listener.getsockname()[1]
        threading.Thread(target=self._accept, daemon=True).start()

    def stop(self):
        self.listener.close()

    def _accept(self):
        while True:
            try:
                peer, _ = self.listener.accept()
            except OSError:
                return
            self.connections += 1
            target = socket.create_connection(("127.0.0.1", self.target))
            for source, sink in ((peer, target), (target, peer)):
                threading.Thread(target=self._pass, args=(source, sink), daemon=True).start()

    def _pass(self, source, sink):
        try:
            while chunk := source.recv(65536):
                self.bytes += len(chunk)
                sink.sendall(chunk)
        except OSError:
            pass
        # Both ways end with either; each closes what it wrote to.
        try:
            source.shutdown(socket.SHUT_RDWR)
        except OSError:
            pass
        sink.close()
