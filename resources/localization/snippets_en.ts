<?xml version="1.0" encoding="utf-8"?>
<!DOCTYPE TS>
<TS version="2.1" language="en" sourcelanguage="en">
<context>
    <name>Localizable</name>
    <message>
        <source>APPLICATION_NAME</source>
        <extracomment>The title of the card</extracomment>
        <translation>Friends</translation>
    </message>
    <message>
        <source>LOCATING_FRIENDS</source>
        <extracomment>Shown while nobody has been found yet</extracomment>
        <translation>Finding your friends…</translation>
    </message>
    <message>
        <source>NO_FRIENDS_FOUND</source>
        <extracomment>Nobody is at the place that was asked for</extracomment>
        <translation>No friends found there.</translation>
    </message>
    <message>
        <source>SHOW_ALL</source>
        <extracomment>The last row of a list that shows only some friends; tapping it shows all</extracomment>
        <translation>Show all friends</translation>
    </message>
    <message>
        <source>LOCATING</source>
        <extracomment>In the place of a place, while one friend is still being looked for</extracomment>
        <translation>Locating…</translation>
    </message>
    <message>
        <source>NO_LOCATION</source>
        <extracomment>In the place of a place, when none is known</extracomment>
        <translation>No location found</translation>
    </message>
    <message>
        <source>CITY_STATE_LABEL</source>
        <extracomment>%1$@ is the city, %2$@ the state or its code; change their order where the language does</extracomment>
        <translation>%1$@, %2$@</translation>
    </message>
    <message>
        <source>HIDDEN_LOCATION</source>
        <extracomment>In the user’s own row, in the place of a place, while friends cannot see it</extracomment>
        <translation>Hidden from friends</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_SHARED_LOCATION</source>
        <extracomment>Read aloud before the user’s own row while friends can see where the user is</extracomment>
        <translation>Friends can see where you are</translation>
    </message>
    <message>
        <source>LOCATED_NOW</source>
        <extracomment>How old a position is: up to 30 seconds</extracomment>
        <translation>Now</translation>
    </message>
    <message>
        <source>LOCATED_LESS_THAN_30SECONDS</source>
        <extracomment>How old a position is: 31 to 59 seconds. The key’s name is misleading; %@ is always 30</extracomment>
        <translation>Over %@ s ago</translation>
    </message>
    <message>
        <source>LOCATED_MINUTES</source>
        <extracomment>How old a position is: %@ is 1 to 59. Short; a plural text where the language needs one</extracomment>
        <translation>%@ min ago</translation>
    </message>
    <message>
        <source>LOCATED_LESS_THAN_1HR</source>
        <extracomment>How old a position is: 60 to 119 minutes. The key’s name is misleading; %@ is always 1</extracomment>
        <translation>Over %@ h ago</translation>
    </message>
    <message>
        <source>LOCATED_MORE_THAN_1HR</source>
        <extracomment>How old a position is: %@ is 2 or more. Short; a plural text where the language needs one</extracomment>
        <translation>%@ h ago</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_LOCATED_NOW</source>
        <extracomment>Read aloud: how old a position is, up to 30 seconds</extracomment>
        <translation>Located now</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_LOCATED_LESS_THAN_30SECONDS</source>
        <extracomment>Read aloud: 31 to 59 seconds; %@ is always 30</extracomment>
        <translation>Located more than %@ seconds ago</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_LOCATED_MINUTE</source>
        <extracomment>Read aloud: one minute; %@ is always 1</extracomment>
        <translation>Located %@ minute ago</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_LOCATED_MINUTES</source>
        <extracomment>Read aloud: %@ is 2 to 59; a plural text where the language needs one</extracomment>
        <translation>Located %@ minutes ago</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_LOCATED_LESS_THAN_1HR</source>
        <extracomment>Read aloud: 60 to 119 minutes; %@ is always 1</extracomment>
        <translation>Located more than %@ hour ago</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_LOCATED_MORE_THAN_1HR</source>
        <extracomment>Read aloud: %@ is 2 or more; a plural text where the language needs one</extracomment>
        <translation>Located %@ hours ago</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_DISTANCE</source>
        <extracomment>Read aloud: %@ is a distance with its unit</extracomment>
        <translation>%@ away</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_ROW_PARTS</source>
        <extracomment>Read aloud: %1$@ is what was said of a friend so far, %2$@ what comes next, as the language lists things</extracomment>
        <translation>%1$@, %2$@</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_AT_LABEL</source>
        <extracomment>Read aloud: %@ is a town (“Brinmouth, HB”), a place with a name (“Fish Market”, “Home”) or “Locating…”: word it so that each of them fits</extracomment>
        <translation>Place: %@</translation>
    </message>
    <message>
        <source>IMMEDIATE_LABEL</source>
        <extracomment>A promise about one friend, of any gender: the user is told at once where they are</extracomment>
        <translation>You’ll hear where they are now</translation>
    </message>
    <message>
        <source>LEAVING_LABEL</source>
        <extracomment>A promise about one friend, of any gender; %@ is a place with a name (“Work”) or a street: word it so that both fit</extracomment>
        <translation>You’ll hear as they leave %@</translation>
    </message>
    <message>
        <source>ARRIVING_LABEL</source>
        <extracomment>A promise about one friend, of any gender; %@ is a place with a name (“Work”) or a street: word it so that both fit</extracomment>
        <translation>You’ll hear as they reach %@</translation>
    </message>
    <message>
        <source>LEAVING_LABEL_ABSOLUTE</source>
        <extracomment>The same without a place</extracomment>
        <translation>You’ll hear when they leave</translation>
    </message>
    <message>
        <source>ARRIVING_LABEL_ABSOLUTE</source>
        <extracomment>The same without a place</extracomment>
        <translation>You’ll hear when they arrive</translation>
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
    <message>
        <source>ACCESSIBILITY_MAP_FRIEND_AT</source>
        <extracomment>A map read aloud: %1$@ is a friend, %2$@ their place: a town, a place with a name such as “Fish Market”, or “Home”</extracomment>
        <translation>Map: %1$@, %2$@</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_MAP_FRIEND</source>
        <extracomment>A map read aloud: %@ is a friend whose place has no name</extracomment>
        <translation>Map: %@</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_MAP_UNKNOWN</source>
        <extracomment>A map read aloud: %@ is a friend whose place is not known</extracomment>
        <translation>Map: no place known for %@</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_MAP_ACCURACY</source>
        <extracomment>A map read aloud: how sure a place is; %@ is a length such as “25 metres”</extracomment>
        <translation>Accurate to %@</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_MAP_NORTH</source>
        <extracomment>A map read aloud: the direction from the user; %@ is a distance such as “310 m”</extracomment>
        <translation>%@ north of you</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_MAP_NORTHEAST</source>
        <extracomment>The same</extracomment>
        <translation>%@ north-east of you</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_MAP_EAST</source>
        <extracomment>The same</extracomment>
        <translation>%@ east of you</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_MAP_SOUTHEAST</source>
        <extracomment>The same</extracomment>
        <translation>%@ south-east of you</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_MAP_SOUTH</source>
        <extracomment>The same</extracomment>
        <translation>%@ south of you</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_MAP_SOUTHWEST</source>
        <extracomment>The same</extracomment>
        <translation>%@ south-west of you</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_MAP_WEST</source>
        <extracomment>The same</extracomment>
        <translation>%@ west of you</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_MAP_NORTHWEST</source>
        <extracomment>The same</extracomment>
        <translation>%@ north-west of you</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_MAP_SAME_PLACE</source>
        <extracomment>The same for a friend or a place that is where the user is</extracomment>
        <translation>In the same place as you</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_MAP_FENCE_AT</source>
        <extracomment>A map read aloud: a place that a friend leaves or arrives at; %@ is its name</extracomment>
        <translation>Map: the area around %@</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_MAP_FENCE</source>
        <extracomment>The same without a name</extracomment>
        <translation>Map: the area of this notice</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_MAP_RADIUS</source>
        <extracomment>A map read aloud: how large the area is; %@ is a length such as “200 metres”</extracomment>
        <translation>Radius: %@</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_MAP_YOU</source>
        <extracomment>A map read aloud: it shows the user</extracomment>
        <translation>Map: you are here</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_MAP_YOU_UNKNOWN</source>
        <extracomment>The same while the user’s position is not known</extracomment>
        <translation>Map: where you are is not known yet</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_MAP_SENTENCES</source>
        <extracomment>Two sentences of a map read aloud, without the last one’s full stop</extracomment>
        <translation>%1$@. %2$@</translation>
    </message>
</context>
</TS>
