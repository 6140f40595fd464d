<?xml version="1.0" encoding="utf-8"?>
<!DOCTYPE TS>
<TS version="2.1" language="ja" sourcelanguage="en">
<context>
    <name>Localizable</name>
    <message>
        <source>TODAY</source>
        <extracomment>Above a question; %@ is the time of day. English: “Today, %@”</extracomment>
        <translation>今日 %@</translation>
    </message>
    <message>
        <source>ASK</source>
        <extracomment>In the empty field where the next question is written. English: “Ask about your friends”</extracomment>
        <translation>友だちについて聞く</translation>
    </message>
    <message>
        <source>ASK_SHORT</source>
        <extracomment>The same with very large text. English: “Ask”</extracomment>
        <translation>聞く</translation>
    </message>
    <message>
        <source>STATUS_LIVE</source>
        <extracomment>Below the field: what is shown is kept up to date. English: “Live · updated just now”</extracomment>
        <translation>ライブ · たった今更新</translation>
    </message>
    <message>
        <source>STATUS_PAUSED</source>
        <extracomment>Below the field; %@ is a number of minutes. Abbreviate the unit. English: “Paused · updated %@ min ago”</extracomment>
        <translation>一時停止中 · %@分前に更新</translation>
    </message>
    <message>
        <source>STATUS_LOCATING</source>
        <extracomment>Below the field: the user’s own position is being found. English: “Finding where you are…”</extracomment>
        <translation>現在地を確認しています…</translation>
    </message>
    <message>
        <source>STATUS_HIDDEN</source>
        <extracomment>Below the field: friends cannot see the user. English: “Your location is hidden”</extracomment>
        <translation>あなたの位置情報は非公開です</translation>
    </message>
    <message>
        <source>DISTANCE_TEXT</source>
        <extracomment>A frame around each distance (%@, with its unit), for a language that needs one; usually %@ alone. English: “%@”</extracomment>
        <translation>%@</translation>
    </message>
    <message>
        <source>_$!&lt;home&gt;!$_</source>
        <extracomment>A built-in name for a place. English: “Home”</extracomment>
        <translation>自宅</translation>
    </message>
    <message>
        <source>_$!&lt;work&gt;!$_</source>
        <extracomment>A built-in name for a place. English: “Work”</extracomment>
        <translation>職場</translation>
    </message>
    <message>
        <source>_$!&lt;school&gt;!$_</source>
        <extracomment>A built-in name for a place. English: “School”</extracomment>
        <translation>学校</translation>
    </message>
    <message>
        <source>_$!&lt;gym&gt;!$_</source>
        <extracomment>A built-in name for a place. English: “Gym”</extracomment>
        <translation>ジム</translation>
    </message>
    <message>
        <source>_$!&lt;other&gt;!$_</source>
        <extracomment>A built-in name for a place. English: “Other”</extracomment>
        <translation>その他</translation>
    </message>
</context>
</TS>
