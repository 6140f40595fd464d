"""A voice assistant's message bus as its programs meet it: one path, JSON texts with exactly a type, data and a context; whoever
sends anything else is told so by the test. Behind it the assistant's own way with a question that nobody understood."""
import asyncio
import json
import threading
import time

import websockets


class BusDouble:
    def __init__(self, port=0):
        self.heard, self.faults, self.peers = [], [], set()
        self.skills = {}
        self.changed = threading.Condition()
        self.loop = asyncio.new_event_loop()
        started = threading.Event()
        threading.Thread(target=self._run, args=(port, started), daemon=True).start()
        started.wait()

    def _run(self, port, started):
        asyncio.set_event_loop(self.loop)
        self.server = self.loop.run_until_complete(websockets.serve(self._serve, "127.0.0.1", port))
        self.port = self.server.sockets[0].getsockname()[1]
        started.set()
        self.loop.run_forever()

    @property
    def url(self):
        return f"ws://127.0.0.1:{self.port}/core"

    async def _serve(self, peer, path):
        if path != "/core":
            self.faults.append(path)
            return
        self.peers.add(peer)
        try:
            async for text in peer:
                self._hear(text)
        except websockets.ConnectionClosed:
            pass
        finally:
            self.peers.discard(peer)

    def _hear(self, text):
        try:
            message = json.loads(text)
            fits = isinstance(text, str) and set(message) == {"type", "data", "context"} and isinstance(message["type"], str)
            fits = fits and isinstance(message["data"], dict) and isinstance(message["context"], dict)
            if message["type"] == "speak":
                fits = fits and isinstance(message["data"]["utterance"], str) and isinstance(message["data"]["lang"], str)
        except (ValueError, KeyError, TypeError):
            fits = False
        with self.changed:
            if not fits:
                self.faults.append(text)
            else:
                self.heard.append(message)
                if message["type"] == "ovos.skills.fallback.register":
                    self.skills[message["data"]["skill_id"]] = message["data"]["priority"]
            self.changed.notify_all()

    def say(self, kind, data, context=None):
        self.raw(json.dumps({"type": kind, "data": data, "context": context or {}}))

    def raw(self, text):
        async def send():
            for peer in list(self.peers):
                await peer.send(text)
        asyncio.run_coroutine_threadsafe(send(), self.loop).result(20)

    def drop(self):
        """The bus goes, as when the assistant is started anew: it forgets who registered."""
        self.skills.clear()

        async def close():
            for peer in list(self.peers):
                await peer.close()
        asyncio.run_coroutine_threadsafe(close(), self.loop).result(20)

    def wait_for(self, fits, since=0, seconds=60):
        """The first message from `since` on that fits; none when there is none in time."""
        end = time.monotonic() + seconds
        with self.changed:
            while True:
                for message in self.heard[since:]:
                    if fits(message):
                        return message
                if not self.changed.wait(max(0.0, end - time.monotonic())):
                    return None

    def wait_for_type(self, kind, since=0, seconds=60):
        return self.wait_for(lambda message: message["type"] == kind, since, seconds)

    def ask(self, utterance, lang="en-gb", seconds=60):
        """A question that nobody else understood: who wants it is asked first, then one after the other. What was said, and
        whether it was answered."""
        since = len(self.heard)
        context = {"source": "audio", "destination": "skills", "session": {"session_id": "s"}}
        self.say("ovos.skills.fallback.ping", {"utterances": [utterance], "lang": lang}, context)
        pong = self.wait_for_type("ovos.skills.fallback.pong", since, seconds)
        assert pong and pong["data"]["can_handle"] is True and pong["data"]["skill_id"] in self.skills, pong
        skill = pong["data"]["skill_id"]
        self.say(f"ovos.skills.fallback.{skill}.request", {"skill_id": skill, "utterances": [utterance], "lang": lang}, context)
        done = self.wait_for_type(f"ovos.skills.fallback.{skill}.response", since, seconds)
        assert done, "no answer"
        with self.changed:
            said = [m for m in self.heard[since:] if m["type"] == "speak"]
            assert any(m["type"] == f"ovos.skills.fallback.{skill}.start" for m in self.heard[since:])
        for message in said:
            assert (message["context"]["source"], message["context"]["destination"]) == ("skills", "audio")
            assert message["context"]["session"] == {"session_id": "s"} and message["data"]["lang"] == lang
        return [message["data"]["utterance"] for message in said], done["data"]["result"]

    def stop(self):
        async def close():
            self.server.close()
            await self.server.wait_closed()
        asyncio.run_coroutine_threadsafe(close(), self.loop).result(20)
        self.loop.call_soon_threadsafe(self.loop.stop)
