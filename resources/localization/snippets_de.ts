<?xml version="1.0" encoding="utf-8"?>
<!DOCTYPE TS>
<TS version="2.1" language="de" sourcelanguage="en">
<context>
    <name>Localizable</name>
    <message>
        <source>APPLICATION_NAME</source>
        <extracomment>The title of the card. English: “Friends”</extracomment>
        <translation>Freunde</translation>
    </message>
    <message>
        <source>LOCATING_FRIENDS</source>
        <extracomment>Shown while nobody has been found yet. English: “Finding your friends…”</extracomment>
        <translation>Deine Freunde werden gesucht …</translation>
    </message>
    <message>
        <source>NO_FRIENDS_FOUND</source>
        <extracomment>Nobody is at the place that was asked for. English: “No friends found there.”</extracomment>
        <translation>Dort wurden keine Freunde gefunden.</translation>
    </message>
    <message>
        <source>SHOW_ALL</source>
        <extracomment>The last row of a list that shows only some friends; tapping it shows all. English: “Show all friends”</extracomment>
        <translation>Alle Freunde anzeigen</translation>
    </message>
    <message>
        <source>LOCATING</source>
        <extracomment>In the place of a place, while one friend is still being looked for. English: “Locating…”</extracomment>
        <translation>Standort wird gesucht …</translation>
    </message>
    <message>
        <source>NO_LOCATION</source>
        <extracomment>In the place of a place, when none is known. English: “No location found”</extracomment>
        <translation>Kein Standort gefunden</translation>
    </message>
    <message>
        <source>CITY_STATE_LABEL</source>
        <extracomment>%1$@ is the city, %2$@ the state or its code; change their order where the language does. English: “%1$@, %2$@”</extracomment>
        <translation>%1$@, %2$@</translation>
    </message>
    <message>
        <source>HIDDEN_LOCATION</source>
        <extracomment>In the user’s own row, in the place of a place, while friends cannot see it. English: “Hidden from friends”</extracomment>
        <translation>Für Freunde verborgen</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_SHARED_LOCATION</source>
        <extracomment>Read aloud before the user’s own row while friends can see where the user is. English: “Friends can see where you are”</extracomment>
        <translation>Freunde sehen, wo du bist</translation>
    </message>
    <message>
        <source>LOCATED_NOW</source>
        <extracomment>How old a position is: up to 30 seconds. English: “Now”</extracomment>
        <translation>Jetzt</translation>
    </message>
    <message>
        <source>LOCATED_LESS_THAN_30SECONDS</source>
        <extracomment>How old a position is: 31 to 59 seconds. The key’s name is misleading; %@ is always 30. English: “Over %@ s ago”</extracomment>
        <translation>Vor über %@ Sek.</translation>
    </message>
    <message>
        <source>LOCATED_MINUTES</source>
        <extracomment>How old a position is: %@ is 1 to 59. Short; a plural text where the language needs one. English: “%@ min ago”</extracomment>
        <translation>Vor %@ Min.</translation>
    </message>
    <message>
        <source>LOCATED_LESS_THAN_1HR</source>
        <extracomment>How old a position is: 60 to 119 minutes. The key’s name is misleading; %@ is always 1. English: “Over %@ h ago”</extracomment>
        <translation>Vor über %@ Std.</translation>
    </message>
    <message>
        <source>LOCATED_MORE_THAN_1HR</source>
        <extracomment>How old a position is: %@ is 2 or more. Short; a plural text where the language needs one. English: “%@ h ago”</extracomment>
        <translation>Vor %@ Std.</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_LOCATED_NOW</source>
        <extracomment>Read aloud: how old a position is, up to 30 seconds. English: “Located now”</extracomment>
        <translation>Gerade eben geortet</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_LOCATED_LESS_THAN_30SECONDS</source>
        <extracomment>Read aloud: 31 to 59 seconds; %@ is always 30. English: “Located more than %@ seconds ago”</extracomment>
        <translation>Vor mehr als %@ Sekunden geortet</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_LOCATED_MINUTE</source>
        <extracomment>Read aloud: one minute; %@ is always 1. English: “Located %@ minute ago”</extracomment>
        <translation>Vor %@ Minute geortet</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_LOCATED_MINUTES</source>
        <extracomment>Read aloud: %@ is 2 to 59; a plural text where the language needs one. English: “Located %@ minutes ago”</extracomment>
        <translation>Vor %@ Minuten geortet</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_LOCATED_LESS_THAN_1HR</source>
        <extracomment>Read aloud: 60 to 119 minutes; %@ is always 1. English: “Located more than %@ hour ago”</extracomment>
        <translation>{0, plural, one{Vor mehr als einer Stunde geortet} other{Vor mehr als %@ Stunden geortet}}</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_LOCATED_MORE_THAN_1HR</source>
        <extracomment>Read aloud: %@ is 2 or more; a plural text where the language needs one. English: “Located %@ hours ago”</extracomment>
        <translation>Vor %@ Stunden geortet</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_DISTANCE</source>
        <extracomment>Read aloud: %@ is a distance with its unit. English: “%@ away”</extracomment>
        <translation>%@ entfernt</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_ROW_PARTS</source>
        <extracomment>Read aloud: %1$@ is what was said of a friend so far, %2$@ what comes next, as the language lists things</extracomment>
        <translation>%1$@, %2$@</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_AT_LABEL</source>
        <extracomment>Read aloud: %@ is a town (“Brinmouth, HB”), a place with a name (“Fish Market”, “Home”) or “Locating…”: word it so that each of them fits. English: “Place: %@”</extracomment>
        <translation>Ort: %@</translation>
    </message>
    <message>
        <source>IMMEDIATE_LABEL</source>
        <extracomment>A promise about one friend, of any gender: the user is told at once where they are. English: “You’ll hear where they are now”</extracomment>
        <translation>Du erfährst sofort den Ort</translation>
    </message>
    <message>
        <source>LEAVING_LABEL</source>
        <extracomment>A promise about one friend, of any gender; %@ is a place with a name (“Work”) or a street: word it so that both fit. English: “You’ll hear as they leave %@”</extracomment>
        <translation>Info bei Aufbruch: %@</translation>
    </message>
    <message>
        <source>ARRIVING_LABEL</source>
        <extracomment>A promise about one friend, of any gender; %@ is a place with a name (“Work”) or a street: word it so that both fit. English: “You’ll hear as they reach %@”</extracomment>
        <translation>Info bei Ankunft: %@</translation>
    </message>
    <message>
        <source>LEAVING_LABEL_ABSOLUTE</source>
        <extracomment>The same without a place. English: “You’ll hear when they leave”</extracomment>
        <translation>Info bei Aufbruch</translation>
    </message>
    <message>
        <source>ARRIVING_LABEL_ABSOLUTE</source>
        <extracomment>The same without a place. English: “You’ll hear when they arrive”</extracomment>
        <translation>Info bei Ankunft</translation>
    </message>
    <message>
        <source>_$!&lt;home&gt;!$_</source>
        <extracomment>A built-in name for a place. English: “Home”</extracomment>
        <translation>Zuhause</translation>
    </message>
    <message>
        <source>_$!&lt;work&gt;!$_</source>
        <extracomment>A built-in name for a place. English: “Work”</extracomment>
        <translation>Arbeit</translation>
    </message>
    <message>
        <source>_$!&lt;school&gt;!$_</source>
        <extracomment>A built-in name for a place. English: “School”</extracomment>
        <translation>Schule</translation>
    </message>
    <message>
        <source>_$!&lt;gym&gt;!$_</source>
        <extracomment>A built-in name for a place. English: “Gym”</extracomment>
        <translation>Fitnessstudio</translation>
    </message>
    <message>
        <source>_$!&lt;other&gt;!$_</source>
        <extracomment>A built-in name for a place. English: “Other”</extracomment>
        <translation>Anderer Ort</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_MAP_FRIEND_AT</source>
        <extracomment>A map read aloud: %1$@ is a friend, %2$@ their place: a town, a place with a name such as “Fish Market”, or “Home”. English: “Map: %1$@, %2$@”</extracomment>
        <translation>Karte: %1$@, %2$@</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_MAP_FRIEND</source>
        <extracomment>A map read aloud: %@ is a friend whose place has no name. English: “Map: %@”</extracomment>
        <translation>Karte: %@</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_MAP_UNKNOWN</source>
        <extracomment>A map read aloud: %@ is a friend whose place is not known. English: “Map: no place known for %@”</extracomment>
        <translation>Karte: kein Ort für %@ bekannt</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_MAP_ACCURACY</source>
        <extracomment>A map read aloud: how sure a place is; %@ is a length such as “25 metres”. English: “Accurate to %@”</extracomment>
        <translation>Auf %@ genau</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_MAP_NORTH</source>
        <extracomment>A map read aloud: the direction from the user; %@ is a distance such as “310 m”. English: “%@ north of you”</extracomment>
        <translation>%@ nördlich von dir</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_MAP_NORTHEAST</source>
        <extracomment>The same. English: “%@ north-east of you”</extracomment>
        <translation>%@ nordöstlich von dir</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_MAP_EAST</source>
        <extracomment>The same. English: “%@ east of you”</extracomment>
        <translation>%@ östlich von dir</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_MAP_SOUTHEAST</source>
        <extracomment>The same. English: “%@ south-east of you”</extracomment>
        <translation>%@ südöstlich von dir</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_MAP_SOUTH</source>
        <extracomment>The same. English: “%@ south of you”</extracomment>
        <translation>%@ südlich von dir</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_MAP_SOUTHWEST</source>
        <extracomment>The same. English: “%@ south-west of you”</extracomment>
        <translation>%@ südwestlich von dir</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_MAP_WEST</source>
        <extracomment>The same. English: “%@ west of you”</extracomment>
        <translation>%@ westlich von dir</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_MAP_NORTHWEST</source>
        <extracomment>The same. English: “%@ north-west of you”</extracomment>
        <translation>%@ nordwestlich von dir</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_MAP_SAME_PLACE</source>
        <extracomment>The same for a friend or a place that is where the user is. English: “In the same place as you”</extracomment>
        <translation>Am selben Ort wie du</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_MAP_FENCE_AT</source>
        <extracomment>A map read aloud: a place that a friend leaves or arrives at; %@ is its name. English: “Map: the area around %@”</extracomment>
        <translation>Karte: %@ und Umgebung</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_MAP_FENCE</source>
        <extracomment>The same without a name. English: “Map: the area of this notice”</extracomment>
        <translation>Karte: das Gebiet dieser Benachrichtigung</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_MAP_RADIUS</source>
        <extracomment>A map read aloud: how large the area is; %@ is a length such as “200 metres”. English: “Radius: %@”</extracomment>
        <translation>Radius: %@</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_MAP_YOU</source>
        <extracomment>A map read aloud: it shows the user. English: “Map: you are here”</extracomment>
        <translation>Karte: Du bist hier</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_MAP_YOU_UNKNOWN</source>
        <extracomment>The same while the user’s position is not known. English: “Map: where you are is not known yet”</extracomment>
        <translation>Karte: Dein Ort ist noch nicht bekannt</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_MAP_SENTENCES</source>
        <extracomment>Two sentences of a map read aloud, without the last one’s full stop. English: “%1$@. %2$@”</extracomment>
        <translation>%1$@. %2$@</translation>
    </message>
</context>
</TS>
