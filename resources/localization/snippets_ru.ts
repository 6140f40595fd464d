<?xml version="1.0" encoding="utf-8"?>
<!DOCTYPE TS>
<TS version="2.1" language="ru" sourcelanguage="en">
<context>
    <name>Localizable</name>
    <message>
        <source>APPLICATION_NAME</source>
        <extracomment>The title of the card. English: “Friends”</extracomment>
        <translation>Друзья</translation>
    </message>
    <message>
        <source>LOCATING_FRIENDS</source>
        <extracomment>Shown while nobody has been found yet. English: “Finding your friends…”</extracomment>
        <translation>Поиск ваших друзей…</translation>
    </message>
    <message>
        <source>NO_FRIENDS_FOUND</source>
        <extracomment>Nobody is at the place that was asked for. English: “No friends found there.”</extracomment>
        <translation>Друзей там не найдено.</translation>
    </message>
    <message>
        <source>SHOW_ALL</source>
        <extracomment>The last row of a list that shows only some friends; tapping it shows all. English: “Show all friends”</extracomment>
        <translation>Показать всех друзей</translation>
    </message>
    <message>
        <source>LOCATING</source>
        <extracomment>In the place of a place, while one friend is still being looked for. English: “Locating…”</extracomment>
        <translation>Определение места…</translation>
    </message>
    <message>
        <source>NO_LOCATION</source>
        <extracomment>In the place of a place, when none is known. English: “No location found”</extracomment>
        <translation>Место не найдено</translation>
    </message>
    <message>
        <source>CITY_STATE_LABEL</source>
        <extracomment>%1$@ is the city, %2$@ the state or its code; change their order where the language does. English: “%1$@, %2$@”</extracomment>
        <translation>%1$@, %2$@</translation>
    </message>
    <message>
        <source>HIDDEN_LOCATION</source>
        <extracomment>In the user’s own row, in the place of a place, while friends cannot see it. English: “Hidden from friends”</extracomment>
        <translation>Скрыто от друзей</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_SHARED_LOCATION</source>
        <extracomment>Read aloud before the user’s own row while friends can see where the user is. English: “Friends can see where you are”</extracomment>
        <translation>Друзья видят, где вы</translation>
    </message>
    <message>
        <source>LOCATED_NOW</source>
        <extracomment>How old a position is: up to 30 seconds. English: “Now”</extracomment>
        <translation>Сейчас</translation>
    </message>
    <message>
        <source>LOCATED_LESS_THAN_30SECONDS</source>
        <extracomment>How old a position is: 31 to 59 seconds. The key’s name is misleading; %@ is always 30. English: “Over %@ s ago”</extracomment>
        <translation>Более %@ сек. назад</translation>
    </message>
    <message>
        <source>LOCATED_MINUTES</source>
        <extracomment>How old a position is: %@ is 1 to 59. Short; a plural text where the language needs one. English: “%@ min ago”</extracomment>
        <translation>%@ мин. назад</translation>
    </message>
    <message>
        <source>LOCATED_LESS_THAN_1HR</source>
        <extracomment>How old a position is: 60 to 119 minutes. The key’s name is misleading; %@ is always 1. English: “Over %@ h ago”</extracomment>
        <translation>Более %@ ч назад</translation>
    </message>
    <message>
        <source>LOCATED_MORE_THAN_1HR</source>
        <extracomment>How old a position is: %@ is 2 or more. Short; a plural text where the language needs one. English: “%@ h ago”</extracomment>
        <translation>%@ ч назад</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_LOCATED_NOW</source>
        <extracomment>Read aloud: how old a position is, up to 30 seconds. English: “Located now”</extracomment>
        <translation>Место определено только что</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_LOCATED_LESS_THAN_30SECONDS</source>
        <extracomment>Read aloud: 31 to 59 seconds; %@ is always 30. English: “Located more than %@ seconds ago”</extracomment>
        <translation>Место определено более %@ секунд назад</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_LOCATED_MINUTE</source>
        <extracomment>Read aloud: one minute; %@ is always 1. English: “Located %@ minute ago”</extracomment>
        <translation>Место определено %@ минуту назад</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_LOCATED_MINUTES</source>
        <extracomment>Read aloud: %@ is 2 to 59; a plural text where the language needs one. English: “Located %@ minutes ago”</extracomment>
        <translation>{0, plural, one{Место определено %@ минуту назад} few{Место определено %@ минуты назад} many{Место определено %@ минут назад} other{Место определено %@ минуты назад}}</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_LOCATED_LESS_THAN_1HR</source>
        <extracomment>Read aloud: 60 to 119 minutes; %@ is always 1. English: “Located more than %@ hour ago”</extracomment>
        <translation>{0, plural, one{Место определено более часа назад} other{Место определено более %@ часов назад}}</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_LOCATED_MORE_THAN_1HR</source>
        <extracomment>Read aloud: %@ is 2 or more; a plural text where the language needs one. English: “Located %@ hours ago”</extracomment>
        <translation>{0, plural, one{Место определено %@ час назад} few{Место определено %@ часа назад} many{Место определено %@ часов назад} other{Место определено %@ часа назад}}</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_DISTANCE</source>
        <extracomment>Read aloud: %@ is a distance with its unit. English: “%@ away”</extracomment>
        <translation>Расстояние: %@</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_ROW_PARTS</source>
        <extracomment>Read aloud: %1$@ is what was said of a friend so far, %2$@ what comes next, as the language lists things. English: “%1$@, %2$@”</extracomment>
        <translation>%1$@, %2$@</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_AT_LABEL</source>
        <extracomment>Read aloud: %@ is a town (“Brinmouth, HB”), a place with a name (“Fish Market”, “Home”) or “Locating…”: word it so that each of them fits. English: “Place: %@”</extracomment>
        <translation>Место: %@</translation>
    </message>
    <message>
        <source>IMMEDIATE_LABEL</source>
        <extracomment>A promise about one friend, of any gender: the user is told at once where they are. English: “You’ll hear where they are now”</extracomment>
        <translation>Вы сразу узнаете место</translation>
    </message>
    <message>
        <source>LEAVING_LABEL</source>
        <extracomment>A promise about one friend, of any gender; %@ is a place with a name (“Work”) or a street: word it so that both fit. English: “You’ll hear as they leave %@”</extracomment>
        <translation>Сообщу об уходе: %@</translation>
    </message>
    <message>
        <source>ARRIVING_LABEL</source>
        <extracomment>A promise about one friend, of any gender; %@ is a place with a name (“Work”) or a street: word it so that both fit. English: “You’ll hear as they reach %@”</extracomment>
        <translation>Сообщу о прибытии: %@</translation>
    </message>
    <message>
        <source>LEAVING_LABEL_ABSOLUTE</source>
        <extracomment>The same without a place. English: “You’ll hear when they leave”</extracomment>
        <translation>Уведомление об уходе</translation>
    </message>
    <message>
        <source>ARRIVING_LABEL_ABSOLUTE</source>
        <extracomment>The same without a place. English: “You’ll hear when they arrive”</extracomment>
        <translation>Уведомление о прибытии</translation>
    </message>
    <message>
        <source>_$!&lt;home&gt;!$_</source>
        <extracomment>A built-in name for a place. English: “Home”</extracomment>
        <translation>Дом</translation>
    </message>
    <message>
        <source>_$!&lt;work&gt;!$_</source>
        <extracomment>A built-in name for a place. English: “Work”</extracomment>
        <translation>Работа</translation>
    </message>
    <message>
        <source>_$!&lt;school&gt;!$_</source>
        <extracomment>A built-in name for a place. English: “School”</extracomment>
        <translation>Школа</translation>
    </message>
    <message>
        <source>_$!&lt;gym&gt;!$_</source>
        <extracomment>A built-in name for a place. English: “Gym”</extracomment>
        <translation>Спортзал</translation>
    </message>
    <message>
        <source>_$!&lt;other&gt;!$_</source>
        <extracomment>A built-in name for a place. English: “Other”</extracomment>
        <translation>Другое место</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_MAP_FRIEND_AT</source>
        <extracomment>A map read aloud: %1$@ is a friend, %2$@ their place: a town, a place with a name such as “Fish Market”, or “Home”. English: “Map: %1$@, %2$@”</extracomment>
        <translation>Карта: %1$@, %2$@</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_MAP_FRIEND</source>
        <extracomment>A map read aloud: %@ is a friend whose place has no name. English: “Map: %@”</extracomment>
        <translation>Карта: %@</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_MAP_UNKNOWN</source>
        <extracomment>A map read aloud: %@ is a friend whose place is not known. English: “Map: no place known for %@”</extracomment>
        <translation>Карта: %@, место неизвестно</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_MAP_ACCURACY</source>
        <extracomment>A map read aloud: how sure a place is; %@ is a length such as “25 metres”. English: “Accurate to %@”</extracomment>
        <translation>Точность: %@</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_MAP_NORTH</source>
        <extracomment>A map read aloud: the direction from the user; %@ is a distance such as “310 m”. English: “%@ north of you”</extracomment>
        <translation>%@ к северу от вас</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_MAP_NORTHEAST</source>
        <extracomment>The same. English: “%@ north-east of you”</extracomment>
        <translation>%@ к северо-востоку от вас</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_MAP_EAST</source>
        <extracomment>The same. English: “%@ east of you”</extracomment>
        <translation>%@ к востоку от вас</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_MAP_SOUTHEAST</source>
        <extracomment>The same. English: “%@ south-east of you”</extracomment>
        <translation>%@ к юго-востоку от вас</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_MAP_SOUTH</source>
        <extracomment>The same. English: “%@ south of you”</extracomment>
        <translation>%@ к югу от вас</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_MAP_SOUTHWEST</source>
        <extracomment>The same. English: “%@ south-west of you”</extracomment>
        <translation>%@ к юго-западу от вас</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_MAP_WEST</source>
        <extracomment>The same. English: “%@ west of you”</extracomment>
        <translation>%@ к западу от вас</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_MAP_NORTHWEST</source>
        <extracomment>The same. English: “%@ north-west of you”</extracomment>
        <translation>%@ к северо-западу от вас</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_MAP_SAME_PLACE</source>
        <extracomment>The same for a friend or a place that is where the user is. English: “In the same place as you”</extracomment>
        <translation>Там же, где и вы</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_MAP_FENCE_AT</source>
        <extracomment>A map read aloud: a place that a friend leaves or arrives at; %@ is its name. English: “Map: the area around %@”</extracomment>
        <translation>Карта: %@ и окрестности</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_MAP_FENCE</source>
        <extracomment>The same without a name. English: “Map: the area of this notice”</extracomment>
        <translation>Карта: область этого уведомления</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_MAP_RADIUS</source>
        <extracomment>A map read aloud: how large the area is; %@ is a length such as “200 metres”. English: “Radius: %@”</extracomment>
        <translation>Радиус: %@</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_MAP_YOU</source>
        <extracomment>A map read aloud: it shows the user. English: “Map: you are here”</extracomment>
        <translation>Карта: вы здесь</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_MAP_YOU_UNKNOWN</source>
        <extracomment>The same while the user’s position is not known. English: “Map: where you are is not known yet”</extracomment>
        <translation>Карта: ваше место пока неизвестно</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_MAP_SENTENCES</source>
        <extracomment>Two sentences of a map read aloud, without the last one’s full stop. English: “%1$@. %2$@”</extracomment>
        <translation>%1$@. %2$@</translation>
    </message>
</context>
</TS>
