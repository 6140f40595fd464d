"""The assistant's message bus: JSON texts over a websocket, each with a type, data and a context."""
import json
import threading
import time

import websocket

LONGEST_PAUSE = 30.0  # seconds
SILENCE = 10.0  # seconds until a bus that does not take a connection counts as away


class Message:
    def __init__(self, kind, data=None, context=None):
        self.type, self.data, self.context = kind, data or {}, context or {}

    @classmethod
    def read(cls, text):
        """None for what is no message."""
        try:
            message = json.loads(text)
        except (ValueError, RecursionError):
            return None
        if not isinstance(message, dict) or not isinstance(message.get("type"), str):
            return None
        parts = [message.get(name) if isinstance(message.get(name), dict) else {} for name in ("data", "context")]
        return cls(message["type"], *parts)

    def answer(self, kind, data=None):
        """One in the same conversation, to whoever sent this."""
        context = dict(self.context)
        context.update({to: self.context[from_] for to, from_ in (("source", "destination"), ("destination", "source"))
                        if from_ in self.context})
        return Message(kind, data, context)

    def text(self):
        return json.dumps({"type": self.type, "data": self.data, "context": self.context})


class Bus:
    """Keeps connected to a bus until it is closed; `greet` is called with each connection, `hear` with each message."""

    def __init__(self, url, greet, hear):
        self.url, self.greet, self.hear = url, greet, hear
        self.socket = None
        self.lock = threading.Lock()
        self.closed = threading.Event()

    def send(self, message):
        """Whether it was sent: without a bus nobody hears it."""
        with self.lock:
            try:
                if self.socket is not None:
                    self.socket.send(message.text())
                    return True
            except (OSError, websocket.WebSocketException):
                pass
        return False

    def run(self):
        pause = 1.0
        while not self.closed.is_set():
            began = time.monotonic()
            try:
                # The assistant is asked directly, whatever proxy the environment names.
                connected = websocket.create_connection(self.url, timeout=SILENCE, http_no_proxy=["*"])
                connected.settimeout(None)
                with self.lock:
                    self.socket = connected
                self.greet()
                self._listen(connected)
            except (OSError, websocket.WebSocketException):
                pass
            finally:
                with self.lock:
                    self.socket = None
            pause = 1.0 if time.monotonic() - began > LONGEST_PAUSE else min(pause * 2, LONGEST_PAUSE)
            self.closed.wait(pause)

    def _listen(self, connected):
        while not self.closed.is_set():
            kind, text = connected.recv_data()
            if kind == websocket.ABNF.OPCODE_CLOSE:
                return
            message = Message.read(text)
            if message is not None:
                self.hear(message)

    def close(self):
        self.closed.set()
        with self.lock:
            if self.socket is not None:
                # Wakes whoever reads; the bus sees a connection that ended.
                self.socket.shutdown()
