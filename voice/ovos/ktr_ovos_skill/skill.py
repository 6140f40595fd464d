"""What the assistant did not understand itself is asked of `ktr`, which understands some of it."""
import queue
import sys
import threading

from .asking import LONGEST_QUESTION, Asking, Pictures, language_tag
from .bus import Bus, Message

SKILL = "ktr-skill.ktr"
PRIORITY = 50  # in the middle of those who try what nobody understood
REGISTER = "ovos.skills.fallback.register"
PING, PONG = "ovos.skills.fallback.ping", "ovos.skills.fallback.pong"
OURS = f"ovos.skills.fallback.{SKILL}"
READY = "mycroft.ready"
MOST_WAITING = 4


class Skill:
    """Never changes anything, and tells only of friends who may be said aloud: both are `ktr ask --aloud`."""

    def __init__(self, options):
        self.options = options
        self.pictures = None if options.no_picture else Pictures()
        self.bus = Bus(options.bus, self.register, self.hear)
        self.questions = queue.Queue(MOST_WAITING)
        self.hiding = None
        self.asking = None
        self.lock = threading.Lock()  # of what is shown

    def register(self):
        self.bus.send(Message(REGISTER, {"skill_id": SKILL, "priority": PRIORITY}))

    def hear(self, message):
        if message.type == READY:
            # The assistant started anew and knows nobody.
            self.register()
        elif message.type == PING:
            self.bus.send(message.answer(PONG, {"skill_id": SKILL, "can_handle": True}))
        elif message.type == f"{OURS}.request":
            try:
                self.questions.put_nowait(message)
            except queue.Full:
                self.close_question(message, False)

    def close_question(self, message, handled):
        self.bus.send(message.answer(f"{OURS}.response", {"result": handled, "fallback_handler": SKILL}))

    def handle(self, message):
        self.bus.send(message.answer(f"{OURS}.start"))
        utterances = message.data.get("utterances")
        question = utterances[0] if isinstance(utterances, list) and utterances else message.data.get("utterance")
        if not isinstance(question, str) or not 0 < len(question.encode("utf-8", "replace")) <= LONGEST_QUESTION or "\0" in question:
            return self.close_question(message, False)
        self.hide()
        try:
            asking = Asking(self.options.ktr, question.encode("utf-8", "replace").decode(), language_tag(message.data.get("lang")),
                            self.pictures and self.pictures.next(), self.options.patience)
        except OSError as error:
            print(f"ktr-ovos-skill: {self.options.ktr}: {error.strerror}", file=sys.stderr)
            return self.close_question(message, False)
        self.asking = asking
        answer = asking.answer
        sentence = answer.get("sentence") if answer and answer.get("outcome") != "notUnderstood" else None
        if sentence:
            lang = message.data.get("lang")
            self.bus.send(message.answer("speak", {"utterance": sentence, "lang": lang if isinstance(lang, str) else "en-us",
                                                   "expect_response": False, "meta": {"skill": SKILL}}))
        self.close_question(message, bool(sentence))
        self.show(message, asking.finish(), sentence)

    def show(self, message, picture, sentence):
        if picture is None:
            if self.pictures:
                self.pictures.remove()
            return
        self.bus.send(message.answer("gui.value.set", {"__from": SKILL, "image": str(picture), "title": None, "caption": None,
                                                       "fill": "PreserveAspectFit", "background_color": None}))
        page = "SYSTEM_ImageFrame"
        self.bus.send(message.answer("gui.page.show", {"__from": SKILL, "page": [f"{page}.qml"], "page_names": [page], "index": 0,
                                                       "__idle": self.options.shown, "__animations": False}))
        with self.lock:
            self.hiding = threading.Timer(self.options.shown, self.hide)
            self.hiding.daemon = True
            self.hiding.start()

    def hide(self):
        """Where somebody was is not left on a screen, nor on a disk."""
        with self.lock:
            if self.hiding is not None:
                self.hiding.cancel()
                self.hiding = None
                # First: who hears that it is no longer shown finds it nowhere.
                self.pictures.remove()
                self.bus.send(Message("gui.clear.namespace", {"__from": SKILL}))

    def work(self):
        while True:
            message = self.questions.get()
            if message is None:
                return
            self.handle(message)

    def run(self):
        worker = threading.Thread(target=self.work, daemon=True)
        worker.start()
        self.bus.run()

    def close(self):
        self.hide()
        self.bus.close()
        if self.asking is not None:
            self.asking.end()
        if self.pictures:
            self.pictures.close()
