"""A phone with a tracker, as its two kinds behave: what is queued while there is no network, what is sent again and what is
lost, whom it believes an answer to be about."""
import base64
import collections
import ctypes
import ctypes.util
import http.client
import json
import os
import pathlib
import random
import ssl
import time
import urllib.parse

import jsonschema

SCHEMA = jsonschema.Draft7Validator(
    json.loads((pathlib.Path(__file__).parent / "schemas" / "phone-answer.json").read_text(encoding="utf-8")))
# What each kind of phone says of itself.
AGENTS = {"android": "Owntracks-Android/gms/420600004", "ios": "OwnTracks/26.3.1 CFNetwork/3826.500.131 Darwin/24.5.0"}
# What may never get further than the service's door.
PRIVATE = ("HiddenNetworkName", "0a:1b:2c:3d:4e:5f", "HiddenRegion", "hiddenmotion", "hiddentag", "hiddentopic", "hiddenpoi")


class Seal:
    """The secret box in which a phone with a key puts its messages."""

    def __init__(self, key):
        self._sodium = ctypes.CDLL(ctypes.util.find_library("sodium"))
        self._key = key.encode().ljust(32, b"\0")

    def close(self, plain):
        nonce, box = os.urandom(24), ctypes.create_string_buffer(len(plain) + 16)
        self._sodium.crypto_secretbox_easy(box, plain, ctypes.c_ulonglong(len(plain)), nonce, self._key)
        return {"_type": "encrypted", "data": base64.b64encode(nonce + box.raw).decode()}

    def open(self, message):
        data = base64.b64decode(message["data"], validate=True)
        plain = ctypes.create_string_buffer(len(data) - 40)
        failed = self._sodium.crypto_secretbox_open_easy(plain, data[24:], ctypes.c_ulonglong(len(data) - 24), data[:24],
                                                         self._key)
        assert failed == 0, "an answer that the phone's key does not open"
        return plain.raw


class Contact:
    def __init__(self):
        self.name = self.face = self.location = None


class Phone:
    """What is typed into it are the three fields `url`, `user` and `password` (and, if wanted, `key`)."""

    def __init__(self, kind, url, user, password, authority, key=None):
        self.kind, self.user = kind, user
        self._url = urllib.parse.urlsplit(url)
        self._credentials = "Basic " + base64.b64encode(f"{user}:{password}".encode("ascii")).decode()
        self._context = ssl.create_default_context(cafile=authority)
        self._seal = Seal(key) if key else None
        self._connection = None
        self.online = True
        self.queue = collections.deque()
        self.contacts = collections.defaultdict(Contact)  # by the identity under which the phone keeps a friend
        self.answers = []   # what came back, opened
        self.alerts = []    # what the phone complained of to its owner
        self.lost = 0       # answers that it could not take

    # What its tracker notices.

    def locate(self, latitude, longitude, when=None, trigger="u", **members):
        message = {"_type": "location", "lat": latitude, "lon": longitude, "tst": int(when or time.time()), "acc": 12,
                   "tid": self.user[:2].lower(), "t": trigger, "m": 1, "batt": 80, "bs": 1, "conn": "w", "SSID": PRIVATE[0],
                   "BSSID": PRIVATE[1], "inregions": [PRIVATE[2]], "inrids": ["1f2e3d"], "motionactivities": [PRIVATE[3]],
                   "tag": PRIVATE[4], "topic": f"owntracks/{PRIVATE[5]}/phone", "poi": PRIVATE[6],
                   "created_at": int(time.time()), **members}
        if message["acc"] == 0:
            del message["acc"]  # as both leave out what is zero
        self.put(message)

    def put(self, message):
        """A message, or bytes that are none, waits for its turn."""
        self.queue.append(message)

    # What its network does.

    def send(self):
        """Sends what waits, in order, as far as that goes; whether nothing waits any more."""
        while self.queue and self.online:
            if not self._deliver(self.queue[0]):
                return False
            self.queue.popleft()
        return not self.queue

    def _deliver(self, message):
        """Whether the message need not be sent again."""
        body = message if isinstance(message, bytes) else json.dumps(message).encode()
        if self._seal and not isinstance(message, bytes):
            body = json.dumps(self._seal.close(body)).encode()
        try:
            status, answer = self._post(body)
        except (OSError, http.client.HTTPException):
            self._connection = None
            return False
        if 200 <= status < 300:
            self._take(answer)
            return True
        if self.kind == "ios" and 400 <= status < 500:
            self.alerts.append(status)
            return True
        return False

    def _post(self, body):
        if self._connection is None:
            self._connection = http.client.HTTPSConnection(self._url.hostname, self._url.port, context=self._context,
                                                           timeout=30)
        android = self.kind == "android"
        self._connection.request("POST", self._url.path, body, {
            "Content-Type": "application/json; charset=utf-8" if android else "application/json",
            "Authorization": self._credentials, "User-Agent": AGENTS[self.kind],
            # What somebody typed, or what stands there when nobody did: never who it is.
            "X-Limit-U": self.user if android else "user", "X-Limit-D": "phone" if android else "device"})
        answer = self._connection.getresponse()
        return answer.status, answer.read()

    def close(self):
        if self._connection is not None:
            self._connection.close()
            self._connection = None

    # What it makes of an answer.

    def _take(self, body):
        try:
            answer = self._opened(json.loads(body)) if body or self.kind == "ios" else []
        except ValueError:
            self.lost += 1
            return
        self.answers.append(answer)
        messages = answer if isinstance(answer, list) else [answer]
        if not (self._android_reads(messages) if self.kind == "android" else SCHEMA.is_valid(answer)):
            self.lost += 1
            return
        for message in messages:
            self._keep(message)

    def _opened(self, answer):
        alone = answer[0] if isinstance(answer, list) and len(answer) == 1 else answer
        if self._seal and isinstance(alone, dict) and alone.get("_type") == "encrypted":
            return json.loads(self._seal.open(alone))
        return answer

    @staticmethod
    def _android_reads(messages):
        """One element that it cannot read costs it all."""
        needed = {"location": ("lat", "lon", "tst"), "transition": ("event", "tst", "acc"), "card": (), "cmd": ("action",),
                  "waypoints": ("waypoints",), "status": (), "lwt": ("tst",), "encrypted": ("data",)}
        for message in messages:
            kind = message.get("_type")
            if kind not in needed or any(message.get(name) is None for name in needed[kind]):
                return False
            if any(name in message and not isinstance(message[name], int) for name in ("tst", "acc", "wtst")):
                return False
            if kind in ("location", "card") and "topic" not in message and not message.get("tid"):
                return False
        return True

    def _keep(self, message):
        kind = message["_type"]
        if kind == "transition" and self.kind == "ios":
            return  # a notification, and no more
        if kind == "transition":
            self.contacts["NOKEY"].location = message  # all friends in one ghost
        if kind not in ("location", "card"):
            return
        contact = self.contacts[message.get("topic") or "owntracks/http/" + message["tid"]]
        if kind == "card":
            contact.name, contact.face = message.get("name"), message.get("face")
        elif contact.location is None or message["tst"] > contact.location["tst"]:
            contact.location = message

    def shown(self, identity):
        """What stands beside a friend's place."""
        contact, tid = self.contacts[identity], identity.rsplit("/", 1)[-1]
        return contact.name or (tid[:2] if self.kind == "android" else tid)


def other_messages(number):
    """Everything else that trackers send, one after the other."""
    now = int(time.time())
    waypoint = {"_type": "waypoint", "desc": "Allotment", "lat": 50.2, "lon": -3.1, "rad": 100, "tst": now - 9000, "rid": "a1"}
    kinds = [
        {"_type": "transition", "event": random.choice(("enter", "leave")), "wtst": now - 9000, "tst": now, "acc": 20,
         "lat": 50.2, "lon": -3.1, "desc": PRIVATE[2], "tid": "an", "t": "c", "rid": "a1"},
        waypoint,
        {"_type": "waypoints", "_creator": "phone", "waypoints": [waypoint]},
        {"_type": "card", "name": "Somebody else", "tid": "xx"},
        {"_type": "status", "android": {"wifi": 1, "ps": 0, "bo": 1, "loc": 0}},
        {"_type": "lwt", "tst": now},
        {"_type": "steps", "tst": now, "steps": 7, "from": now - 60, "to": now},
        {"_type": "beacon", "tst": now, "uuid": "00000000-0000-0000-0000-000000000000", "major": 1, "minor": 2, "prox": 1},
        {"_type": "request", "request": "tours"},
        {"_type": "cmd", "action": "dump"},
        {"_type": "configuration", "mode": 3, "deviceId": "phone"},
        {"_type": "one from the future", "tst": None},
        b"", b"{", b"[]", b"\xff\xfe", b'{"_type":"location"}', b'{"_type":"location","lat":1e999,"lon":1,"tst":2}',
        b'{"_type":"encrypted","data":"AAAA"}',
    ]
    return kinds[number % len(kinds)]
