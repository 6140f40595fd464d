<?xml version="1.0" encoding="utf-8"?>
<!DOCTYPE TS>
<TS version="2.1" language="en" sourcelanguage="en">
<context>
    <name>Localizable</name>
    <message>
        <source>TODAY</source>
        <extracomment>Above a question; %@ is the time of day</extracomment>
        <translation>Today, %@</translation>
    </message>
    <message>
        <source>ASK</source>
        <extracomment>In the empty field where the next question is written</extracomment>
        <translation>Ask about your friends</translation>
    </message>
    <message>
        <source>ASK_SHORT</source>
        <extracomment>The same with very large text</extracomment>
        <translation>Ask</translation>
    </message>
    <message>
        <source>STATUS_LIVE</source>
        <extracomment>Below the field: what is shown is kept up to date</extracomment>
        <translation>Live · updated just now</translation>
    </message>
    <message>
        <source>STATUS_PAUSED</source>
        <extracomment>Below the field; %@ is a number of minutes. Abbreviate the unit</extracomment>
        <translation>Paused · updated %@ min ago</translation>
    </message>
    <message>
        <source>STATUS_LOCATING</source>
        <extracomment>Below the field: the user’s own position is being found</extracomment>
        <translation>Finding where you are…</translation>
    </message>
    <message>
        <source>STATUS_HIDDEN</source>
        <extracomment>Below the field: friends cannot see the user</extracomment>
        <translation>Your location is hidden</translation>
    </message>
    <message>
        <source>DISTANCE_TEXT</source>
        <extracomment>A frame around each distance (%@, with its unit), for a language that needs one; usually %@ alone</extracomment>
        <translation>%@</translation>
    </message>
    <message>
        <source>_$!&lt;home&gt;!$_</source>
        <extracomment>A built-in name for a place</extracomment>
        <translation>Home</translation>
    </message>
    <message>
        <source>_$!&lt;work&gt;!$_</source>
        <extracomment>A built-in name for a place</extracomment>
        <translation>Work</translation>
    </message>
    <message>
        <source>_$!&lt;school&gt;!$_</source>
        <extracomment>A built-in name for a place</extracomment>
        <translation>School</translation>
    </message>
    <message>
        <source>_$!&lt;gym&gt;!$_</source>
        <extracomment>A built-in name for a place</extracomment>
        <translation>Gym</translation>
    </message>
    <message>
        <source>_$!&lt;other&gt;!$_</source>
        <extracomment>A built-in name for a place</extracomment>
        <translation>Other</translation>
    </message>
</context>
</TS>
