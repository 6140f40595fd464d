"""Answers "where is Ann?" for a voice assistant: listens on its message bus, asks `ktr`, says and shows the answer."""
