<?xml version="1.0" encoding="utf-8"?>
<!DOCTYPE TS>
<TS version="2.1" language="nl" sourcelanguage="en">
<context>
    <name>Localizable</name>
    <message>
        <source>APPLICATION_NAME</source>
        <extracomment>The title of the card. English: “Friends”</extracomment>
        <translation>Vrienden</translation>
    </message>
    <message>
        <source>LOCATING_FRIENDS</source>
        <extracomment>Shown while nobody has been found yet. English: “Finding your friends…”</extracomment>
        <translation>Je vrienden worden gezocht…</translation>
    </message>
    <message>
        <source>NO_FRIENDS_FOUND</source>
        <extracomment>Nobody is at the place that was asked for. English: “No friends found there.”</extracomment>
        <translation>Daar zijn geen vrienden gevonden.</translation>
    </message>
    <message>
        <source>SHOW_ALL</source>
        <extracomment>The last row of a list that shows only some friends; tapping it shows all. English: “Show all friends”</extracomment>
        <translation>Alle vrienden tonen</translation>
    </message>
    <message>
        <source>LOCATING</source>
        <extracomment>In the place of a place, while one friend is still being looked for. English: “Locating…”</extracomment>
        <translation>Locatie wordt gezocht…</translation>
    </message>
    <message>
        <source>NO_LOCATION</source>
        <extracomment>In the place of a place, when none is known. English: “No location found”</extracomment>
        <translation>Geen locatie gevonden</translation>
    </message>
    <message>
        <source>CITY_STATE_LABEL</source>
        <extracomment>%1$@ is the city, %2$@ the state or its code; change their order where the language does. English: “%1$@, %2$@”</extracomment>
        <translation>%1$@, %2$@</translation>
    </message>
    <message>
        <source>HIDDEN_LOCATION</source>
        <extracomment>In the user’s own row, in the place of a place, while friends cannot see it. English: “Hidden from friends”</extracomment>
        <translation>Verborgen voor vrienden</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_SHARED_LOCATION</source>
        <extracomment>Read aloud before the user’s own row while friends can see where the user is. English: “Friends can see where you are”</extracomment>
        <translation>Vrienden kunnen zien waar je bent</translation>
    </message>
    <message>
        <source>LOCATED_NOW</source>
        <extracomment>How old a position is: up to 30 seconds. English: “Now”</extracomment>
        <translation>Nu</translation>
    </message>
    <message>
        <source>LOCATED_LESS_THAN_30SECONDS</source>
        <extracomment>How old a position is: 31 to 59 seconds. The key’s name is misleading; %@ is always 30. English: “Over %@ s ago”</extracomment>
        <translation>Meer dan %@ sec. geleden</translation>
    </message>
    <message>
        <source>LOCATED_MINUTES</source>
        <extracomment>How old a position is: %@ is 1 to 59. Short; a plural text where the language needs one. English: “%@ min ago”</extracomment>
        <translation>%@ min. geleden</translation>
    </message>
    <message>
        <source>LOCATED_LESS_THAN_1HR</source>
        <extracomment>How old a position is: 60 to 119 minutes. The key’s name is misleading; %@ is always 1. English: “Over %@ h ago”</extracomment>
        <translation>Meer dan %@ uur geleden</translation>
    </message>
    <message>
        <source>LOCATED_MORE_THAN_1HR</source>
        <extracomment>How old a position is: %@ is 2 or more. Short; a plural text where the language needs one. English: “%@ h ago”</extracomment>
        <translation>%@ uur geleden</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_LOCATED_NOW</source>
        <extracomment>Read aloud: how old a position is, up to 30 seconds. English: “Located now”</extracomment>
        <translation>Zojuist gelokaliseerd</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_LOCATED_LESS_THAN_30SECONDS</source>
        <extracomment>Read aloud: 31 to 59 seconds; %@ is always 30. English: “Located more than %@ seconds ago”</extracomment>
        <translation>Meer dan %@ seconden geleden gelokaliseerd</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_LOCATED_MINUTE</source>
        <extracomment>Read aloud: one minute; %@ is always 1. English: “Located %@ minute ago”</extracomment>
        <translation>%@ minuut geleden gelokaliseerd</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_LOCATED_MINUTES</source>
        <extracomment>Read aloud: %@ is 2 to 59; a plural text where the language needs one. English: “Located %@ minutes ago”</extracomment>
        <translation>%@ minuten geleden gelokaliseerd</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_LOCATED_LESS_THAN_1HR</source>
        <extracomment>Read aloud: 60 to 119 minutes; %@ is always 1. English: “Located more than %@ hour ago”</extracomment>
        <translation>{0, plural, one{Meer dan een uur geleden gelokaliseerd} other{Meer dan %@ uur geleden gelokaliseerd}}</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_LOCATED_MORE_THAN_1HR</source>
        <extracomment>Read aloud: %@ is 2 or more; a plural text where the language needs one. English: “Located %@ hours ago”</extracomment>
        <translation>%@ uur geleden gelokaliseerd</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_DISTANCE</source>
        <extracomment>Read aloud: %@ is a distance with its unit. English: “%@ away”</extracomment>
        <translation>%@ van je vandaan</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_ROW_PARTS</source>
        <extracomment>Read aloud: %1$@ is what was said of a friend so far, %2$@ what comes next, as the language lists things. English: “%1$@, %2$@”</extracomment>
        <translation>%1$@, %2$@</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_AT_LABEL</source>
        <extracomment>Read aloud: %@ is a town (“Brinmouth, HB”), a place with a name (“Fish Market”, “Home”) or “Locating…”: word it so that each of them fits. English: “Place: %@”</extracomment>
        <translation>Plaats: %@</translation>
    </message>
    <message>
        <source>IMMEDIATE_LABEL</source>
        <extracomment>A promise about one friend, of any gender: the user is told at once where they are. English: “You’ll hear where they are now”</extracomment>
        <translation>Je hoort meteen de locatie</translation>
    </message>
    <message>
        <source>LEAVING_LABEL</source>
        <extracomment>A promise about one friend, of any gender; %@ is a place with a name (“Work”) or a street: word it so that both fit. English: “You’ll hear as they leave %@”</extracomment>
        <translation>Melding vertrek: %@</translation>
    </message>
    <message>
        <source>ARRIVING_LABEL</source>
        <extracomment>A promise about one friend, of any gender; %@ is a place with a name (“Work”) or a street: word it so that both fit. English: “You’ll hear as they reach %@”</extracomment>
        <translation>Melding aankomst: %@</translation>
    </message>
    <message>
        <source>LEAVING_LABEL_ABSOLUTE</source>
        <extracomment>The same without a place. English: “You’ll hear when they leave”</extracomment>
        <translation>Melding bij vertrek</translation>
    </message>
    <message>
        <source>ARRIVING_LABEL_ABSOLUTE</source>
        <extracomment>The same without a place. English: “You’ll hear when they arrive”</extracomment>
        <translation>Melding bij aankomst</translation>
    </message>
    <message>
        <source>_$!&lt;home&gt;!$_</source>
        <extracomment>A built-in name for a place. English: “Home”</extracomment>
        <translation>Thuis</translation>
    </message>
    <message>
        <source>_$!&lt;work&gt;!$_</source>
        <extracomment>A built-in name for a place. English: “Work”</extracomment>
        <translation>Werk</translation>
    </message>
    <message>
        <source>_$!&lt;school&gt;!$_</source>
        <extracomment>A built-in name for a place. English: “School”</extracomment>
        <translation>School</translation>
    </message>
    <message>
        <source>_$!&lt;gym&gt;!$_</source>
        <extracomment>A built-in name for a place. English: “Gym”</extracomment>
        <translation>Sportschool</translation>
    </message>
    <message>
        <source>_$!&lt;other&gt;!$_</source>
        <extracomment>A built-in name for a place. English: “Other”</extracomment>
        <translation>Andere plek</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_MAP_FRIEND_AT</source>
        <extracomment>A map read aloud: %1$@ is a friend, %2$@ their place: a town, a place with a name such as “Fish Market”, or “Home”. English: “Map: %1$@, %2$@”</extracomment>
        <translation>Kaart: %1$@, %2$@</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_MAP_FRIEND</source>
        <extracomment>A map read aloud: %@ is a friend whose place has no name. English: “Map: %@”</extracomment>
        <translation>Kaart: %@</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_MAP_UNKNOWN</source>
        <extracomment>A map read aloud: %@ is a friend whose place is not known. English: “Map: no place known for %@”</extracomment>
        <translation>Kaart: geen plaats bekend voor %@</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_MAP_ACCURACY</source>
        <extracomment>A map read aloud: how sure a place is; %@ is a length such as “25 metres”. English: “Accurate to %@”</extracomment>
        <translation>Nauwkeurigheid: %@</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_MAP_NORTH</source>
        <extracomment>A map read aloud: the direction from the user; %@ is a distance such as “310 m”. English: “%@ north of you”</extracomment>
        <translation>%@ ten noorden van jou</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_MAP_NORTHEAST</source>
        <extracomment>The same. English: “%@ north-east of you”</extracomment>
        <translation>%@ ten noordoosten van jou</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_MAP_EAST</source>
        <extracomment>The same. English: “%@ east of you”</extracomment>
        <translation>%@ ten oosten van jou</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_MAP_SOUTHEAST</source>
        <extracomment>The same. English: “%@ south-east of you”</extracomment>
        <translation>%@ ten zuidoosten van jou</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_MAP_SOUTH</source>
        <extracomment>The same. English: “%@ south of you”</extracomment>
        <translation>%@ ten zuiden van jou</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_MAP_SOUTHWEST</source>
        <extracomment>The same. English: “%@ south-west of you”</extracomment>
        <translation>%@ ten zuidwesten van jou</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_MAP_WEST</source>
        <extracomment>The same. English: “%@ west of you”</extracomment>
        <translation>%@ ten westen van jou</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_MAP_NORTHWEST</source>
        <extracomment>The same. English: “%@ north-west of you”</extracomment>
        <translation>%@ ten noordwesten van jou</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_MAP_SAME_PLACE</source>
        <extracomment>The same for a friend or a place that is where the user is. English: “In the same place as you”</extracomment>
        <translation>Op dezelfde plek als jij</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_MAP_FENCE_AT</source>
        <extracomment>A map read aloud: a place that a friend leaves or arrives at; %@ is its name. English: “Map: the area around %@”</extracomment>
        <translation>Kaart: %@ en omgeving</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_MAP_FENCE</source>
        <extracomment>The same without a name. English: “Map: the area of this notice”</extracomment>
        <translation>Kaart: het gebied van deze melding</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_MAP_RADIUS</source>
        <extracomment>A map read aloud: how large the area is; %@ is a length such as “200 metres”. English: “Radius: %@”</extracomment>
        <translation>Straal: %@</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_MAP_YOU</source>
        <extracomment>A map read aloud: it shows the user. English: “Map: you are here”</extracomment>
        <translation>Kaart: je bent hier</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_MAP_YOU_UNKNOWN</source>
        <extracomment>The same while the user’s position is not known. English: “Map: where you are is not known yet”</extracomment>
        <translation>Kaart: waar je bent, is nog niet bekend</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_MAP_SENTENCES</source>
        <extracomment>Two sentences of a map read aloud, without the last one’s full stop. English: “%1$@. %2$@”</extracomment>
        <translation>%1$@. %2$@</translation>
    </message>
</context>
</TS>
