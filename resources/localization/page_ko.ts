<?xml version="1.0" encoding="utf-8"?>
<!DOCTYPE TS>
<TS version="2.1" language="ko" sourcelanguage="en">
<context>
    <name>Localizable</name>
    <message>
        <source>VISIBLE_TO</source>
        <extracomment>Title of the people's page; %@ is the number, in words from NUMBERS or in digits. English: “{0, plural, one{%@ person can see where you are.} other{%@ people can see where you are.}}”</extracomment>
        <translation>{0, plural, other{%@명이 내 위치를 볼 수 있습니다.}}</translation>
    </message>
    <message>
        <source>NUMBERS</source>
        <extracomment>The numbers from one to twelve as they begin VISIBLE_TO, in its gender and case, with a bar between; a hyphen alone where digits are usual. English: “One|Two|Three|Four|Five|Six|Seven|Eight|Nine|Ten|Eleven|Twelve”</extracomment>
        <translation>-</translation>
    </message>
    <message>
        <source>VISIBLE_TO_NOBODY</source>
        <extracomment>Title of the people's page while the reader hides or shares with nobody. English: “Nobody can see where you are.”</extracomment>
        <translation>아무도 내 위치를 볼 수 없습니다.</translation>
    </message>
    <message>
        <source>VISIBLE</source>
        <extracomment>Label of the one switch over everything. English: “Visible to friends”</extracomment>
        <translation>친구에게 보이기</translation>
    </message>
    <message>
        <source>VISIBLE_ON</source>
        <extracomment>Below VISIBLE while the switch is on. English: “Off hides you from everyone at once.”</extracomment>
        <translation>끄면 모두에게서 바로 숨겨집니다.</translation>
    </message>
    <message>
        <source>VISIBLE_OFF</source>
        <extracomment>Below VISIBLE while the switch is off. English: “Turn on, and the rules below hold again.”</extracomment>
        <translation>켜면 아래 규칙이 다시 적용됩니다.</translation>
    </message>
    <message>
        <source>SWITCH_ON</source>
        <extracomment>Spoken: a switch, %@ is its label, is on. English: “%@, on”</extracomment>
        <translation>%@, 켜짐</translation>
    </message>
    <message>
        <source>SWITCH_OFF</source>
        <extracomment>Spoken: a switch, %@ is its label, is off. English: “%@, off”</extracomment>
        <translation>%@, 꺼짐</translation>
    </message>
    <message>
        <source>WHO_SEES_ME</source>
        <extracomment>Heading above the list of people who see the reader. English: “Who sees me”</extracomment>
        <translation>나를 보는 사람</translation>
    </message>
    <message>
        <source>EXACTLY</source>
        <extracomment>How exactly somebody is seen. English: “Exactly”</extracomment>
        <translation>정확하게</translation>
    </message>
    <message>
        <source>WITHIN_1_KM</source>
        <extracomment>How exactly somebody is seen. English: “Within 1 km”</extracomment>
        <translation>1km 이내</translation>
    </message>
    <message>
        <source>TOWN</source>
        <extracomment>How exactly somebody is seen. English: “The town”</extracomment>
        <translation>도시</translation>
    </message>
    <message>
        <source>NAMED_PLACES</source>
        <extracomment>How exactly somebody is seen: only when they are at one of their named places. English: “Only places I have named”</extracomment>
        <translation>내가 이름 붙인 곳만</translation>
    </message>
    <message>
        <source>RULE_ALWAYS</source>
        <extracomment>A rule: %@ is how exactly. English: “%@, always”</extracomment>
        <translation>%@, 항상</translation>
    </message>
    <message>
        <source>RULE_MIDNIGHT</source>
        <extracomment>A rule that ends at the next midnight: %@ is how exactly. English: “%@, until midnight”</extracomment>
        <translation>%@, 자정까지</translation>
    </message>
    <message>
        <source>RULE_TIME</source>
        <extracomment>A rule that ends: %1$@ is how exactly, %2$@ a time or a day and time. English: “%1$@, until %2$@”</extracomment>
        <translation>%1$@, %2$@까지</translation>
    </message>
    <message>
        <source>RULE_PLACE</source>
        <extracomment>A rule that ends when the reader arrives: %1$@ is how exactly, %2$@ the reader's name of a place. English: “%1$@, until you are at %2$@”</extracomment>
        <translation>%1$@, %2$@ 도착까지</translation>
    </message>
    <message>
        <source>RULE_ENDED</source>
        <extracomment>In place of a rule that is over: %@ is a day and time. English: “Ended: %@”</extracomment>
        <translation>끝남: %@</translation>
    </message>
    <message>
        <source>RULE_ASKED</source>
        <extracomment>A rule without an end asks now and then whether it is still meant; %@ is the day on which it ends without an answer. English: “Still meant? Without an answer it ends: %@.”</extracomment>
        <translation>계속할까요? 답이 없으면 끝납니다: %@.</translation>
    </message>
    <message>
        <source>KEEP_SHARING</source>
        <extracomment>Button: the rule goes on. English: “Keep sharing”</extracomment>
        <translation>계속 공유</translation>
    </message>
    <message>
        <source>SHARE_WITH</source>
        <extracomment>Row or button that begins a new rule. English: “Share with somebody”</extracomment>
        <translation>누군가와 공유</translation>
    </message>
    <message>
        <source>ASKED_TITLE</source>
        <extracomment>Above those who asked the reader to share. English: “Would like to see where you are”</extracomment>
        <translation>위치를 보고 싶어 하는 사람</translation>
    </message>
    <message>
        <source>ASKED_SHARE</source>
        <extracomment>Button beside somebody who asked: leads to the page of a rule. English: “Share”</extracomment>
        <translation>공유</translation>
    </message>
    <message>
        <source>ASKED_NOT_NOW</source>
        <extracomment>Button beside it: the request goes, nobody hears of it. English: “Not now”</extracomment>
        <translation>나중에</translation>
    </message>
    <message>
        <source>SHARE_WHO</source>
        <extracomment>Label of a field. English: “Name, e-mail address or phone number”</extracomment>
        <translation>이름, 이메일 주소 또는 전화번호</translation>
    </message>
    <message>
        <source>SHARE_UNKNOWN</source>
        <extracomment>Nobody was found by what was typed. English: “Nobody here is called so. Whoever runs the service can add people.”</extracomment>
        <translation>여기에 그런 이름은 없습니다. 서비스를 운영하는 사람이 추가할 수 있습니다.</translation>
    </message>
    <message>
        <source>SHARE_SELF</source>
        <extracomment>The reader typed their own name. English: “Nobody shares with themselves.”</extracomment>
        <translation>자신과는 공유할 수 없습니다.</translation>
    </message>
    <message>
        <source>GO_ON</source>
        <extracomment>Button: to the next step. English: “Go on”</extracomment>
        <translation>계속</translation>
    </message>
    <message>
        <source>WHO_LOOKED</source>
        <extracomment>Heading above the list of people who looked. English: “Who looked”</extracomment>
        <translation>본 사람</translation>
    </message>
    <message>
        <source>ALL_LOOKS</source>
        <extracomment>Row that opens all that is kept of who looked; %@ is a number of days. English: “{0, plural, one{All of the last day} other{All of the last %@ days}}”</extracomment>
        <translation>{0, plural, other{지난 %@일의 전체}}</translation>
    </message>
    <message>
        <source>NOBODY_LOOKED</source>
        <extracomment>No entry in the list of people who looked. English: “Nobody has looked.”</extracomment>
        <translation>아무도 보지 않았습니다.</translation>
    </message>
    <message>
        <source>CARRIED</source>
        <extracomment>After the name of who looked: their phone fetched it by itself, nobody asked. English: “by their phone alone”</extracomment>
        <translation>휴대폰이 저절로</translation>
    </message>
    <message>
        <source>MY_DATA</source>
        <extracomment>Heading. English: “My phone and my data”</extracomment>
        <translation>내 휴대폰과 데이터</translation>
    </message>
    <message>
        <source>SET_UP_PHONE</source>
        <extracomment>Row and title. English: “Set up a phone”</extracomment>
        <translation>휴대폰 설정</translation>
    </message>
    <message>
        <source>MY_DEVICES</source>
        <extracomment>Row and title: list of phones, programs and browsers. English: “My devices”</extracomment>
        <translation>내 기기</translation>
    </message>
    <message>
        <source>MY_SETTINGS</source>
        <extracomment>Row and title: language, time zone, how long things are kept. English: “Settings”</extracomment>
        <translation>설정</translation>
    </message>
    <message>
        <source>GET_COPY</source>
        <extracomment>Row: a file with everything about the reader. English: “Get a copy of my data”</extracomment>
        <translation>내 데이터 사본 받기</translation>
    </message>
    <message>
        <source>DELETE_ALL</source>
        <extracomment>Row and title. English: “Delete everything about me”</extracomment>
        <translation>나에 관한 모든 것 삭제</translation>
    </message>
    <message>
        <source>SIGN_OUT</source>
        <extracomment>Button. English: “Sign out”</extracomment>
        <translation>로그아웃</translation>
    </message>
    <message>
        <source>BACK</source>
        <extracomment>Spoken: the arrow back. English: “Back”</extracomment>
        <translation>뒤로</translation>
    </message>
    <message>
        <source>SEES_TITLE</source>
        <extracomment>Title of the page about one rule; %@ is a name. English: “What %@ sees”</extracomment>
        <translation>%@님에게 보이는 것</translation>
    </message>
    <message>
        <source>SEES_THIS</source>
        <extracomment>Below a row that shows the reader as %@ sees them. English: “%@ sees you exactly like this.”</extracomment>
        <translation>%@님에게 정확히 이렇게 보입니다.</translation>
    </message>
    <message>
        <source>SEES_NOTHING</source>
        <extracomment>In place of that row; %@ is a name. English: “%@ sees no place of yours now.”</extracomment>
        <translation>지금 %@님에게는 내 위치가 보이지 않습니다.</translation>
    </message>
    <message>
        <source>A_PLACE_WITHIN</source>
        <extracomment>In that row: a place that is known within a distance, %@. English: “Within %@”</extracomment>
        <translation>%@ 이내</translation>
    </message>
    <message>
        <source>HOW_EXACTLY</source>
        <extracomment>Heading above a choice. English: “How exactly”</extracomment>
        <translation>얼마나 정확하게</translation>
    </message>
    <message>
        <source>UNTIL</source>
        <extracomment>Heading above a choice. English: “Until”</extracomment>
        <translation>언제까지</translation>
    </message>
    <message>
        <source>UNTIL_CHANGED</source>
        <extracomment>Choice of when a rule ends: not by itself. English: “I change it”</extracomment>
        <translation>내가 바꿀 때까지</translation>
    </message>
    <message>
        <source>UNTIL_MIDNIGHT</source>
        <extracomment>Choice of when a rule ends. English: “Midnight”</extracomment>
        <translation>자정</translation>
    </message>
    <message>
        <source>UNTIL_ARRIVAL</source>
        <extracomment>Choice of when a rule ends; a list of places follows. English: “I arrive at”</extracomment>
        <translation>도착:</translation>
    </message>
    <message>
        <source>UNTIL_TIME</source>
        <extracomment>Choice of when a rule ends; a field for a time follows. English: “A time”</extracomment>
        <translation>시각</translation>
    </message>
    <message>
        <source>SAID_ALOUD</source>
        <extracomment>Label of a box to tick: speakers may say where the reader is. English: “May be said aloud”</extracomment>
        <translation>소리 내어 말해도 됨</translation>
    </message>
    <message>
        <source>SAID_ALOUD_WHERE</source>
        <extracomment>Below SAID_ALOUD; %@ is a name. English: “Speakers at %@’s may say it”</extracomment>
        <translation>%@님의 스피커가 말해도 됩니다</translation>
    </message>
    <message>
        <source>SAVE</source>
        <extracomment>Button. English: “Save”</extracomment>
        <translation>저장</translation>
    </message>
    <message>
        <source>STOP</source>
        <extracomment>Button and title; %@ is a name. English: “Stop sharing with %@”</extracomment>
        <translation>%@님과 공유 중단</translation>
    </message>
    <message>
        <source>STOP_ASK</source>
        <extracomment>Asks before STOP; %@ is a name. English: “%@ will see nothing of you from now on. What their phone has shown stays on it.”</extracomment>
        <translation>이제부터 %@님은 나에 관해 아무것도 볼 수 없습니다. 휴대폰에 표시된 것은 남습니다.</translation>
    </message>
    <message>
        <source>KEEP</source>
        <extracomment>Button: do not stop, do not delete. English: “Keep”</extracomment>
        <translation>그대로 두기</translation>
    </message>
    <message>
        <source>STEP_INSTALL</source>
        <extracomment>First step of setting up a phone. English: “Install a tracker app that can send to an address of your own.”</extracomment>
        <translation>자신의 주소로 보낼 수 있는 추적 앱을 설치하세요.</translation>
    </message>
    <message>
        <source>STEP_TYPE</source>
        <extracomment>Second step; three values follow. English: “Type these three into it.”</extracomment>
        <translation>이 세 가지를 입력하세요.</translation>
    </message>
    <message>
        <source>STEP_RUN</source>
        <extracomment>Third step. English: “Let it run, then look again: the phone’s first place shows up here.”</extracomment>
        <translation>실행해 두고 다시 보세요. 휴대폰의 첫 위치가 여기에 나타납니다.</translation>
    </message>
    <message>
        <source>ADDRESS</source>
        <extracomment>Label of a value to type. English: “Address”</extracomment>
        <translation>주소</translation>
    </message>
    <message>
        <source>USER</source>
        <extracomment>Label of a value to type. English: “User”</extracomment>
        <translation>사용자</translation>
    </message>
    <message>
        <source>PASSWORD</source>
        <extracomment>Label of a value to type. English: “Password”</extracomment>
        <translation>비밀번호</translation>
    </message>
    <message>
        <source>SHOWN_ONCE</source>
        <extracomment>Warning below the values. English: “This password is shown once. For another phone, set up another.”</extracomment>
        <translation>이 비밀번호는 한 번만 표시됩니다. 다른 휴대폰은 따로 설정하세요.</translation>
    </message>
    <message>
        <source>WAS_SHOWN</source>
        <extracomment>In place of the password; %@ is a day. English: “Shown once: %@.”</extracomment>
        <translation>한 번 표시됨: %@.</translation>
    </message>
    <message>
        <source>ADDRESS_ALONE</source>
        <extracomment>Above an address for apps that take nothing else. English: “For apps that take nothing but an address:”</extracomment>
        <translation>주소만 받는 앱의 경우:</translation>
    </message>
    <message>
        <source>MAKE_PASSWORD</source>
        <extracomment>Button on the first page of setting up a phone. English: “Show what to type”</extracomment>
        <translation>입력할 내용 보기</translation>
    </message>
    <message>
        <source>NOTHING_YET</source>
        <extracomment>No message of a phone has come. English: “Nothing has come yet.”</extracomment>
        <translation>아직 아무것도 오지 않았습니다.</translation>
    </message>
    <message>
        <source>HERE_SINCE</source>
        <extracomment>A phone's first place has come; %1$@ is a time, %2$@ a distance. English: “Here since %1$@, within about %2$@.”</extracomment>
        <translation>%1$@부터 여기, 약 %2$@ 이내.</translation>
    </message>
    <message>
        <source>HERE_SINCE_TIME</source>
        <extracomment>A phone was heard; %@ is a time. English: “Here since %@.”</extracomment>
        <translation>%@부터 여기.</translation>
    </message>
    <message>
        <source>LOOK_AGAIN</source>
        <extracomment>Button: loads the page again. English: “Look again”</extracomment>
        <translation>다시 보기</translation>
    </message>
    <message>
        <source>OTHER_PHONE</source>
        <extracomment>Above a code for a camera. English: “Is the phone another one than this? Point its camera here, and this page opens on it.”</extracomment>
        <translation>다른 휴대폰인가요? 그 카메라를 여기에 대면 이 페이지가 거기서 열립니다.</translation>
    </message>
    <message>
        <source>CODE</source>
        <extracomment>Spoken: a picture with a code for a camera. English: “Code for a camera”</extracomment>
        <translation>카메라용 코드</translation>
    </message>
    <message>
        <source>DEVICE_PHONE</source>
        <extracomment>A device of the reader's. English: “Phone”</extracomment>
        <translation>휴대폰</translation>
    </message>
    <message>
        <source>DEVICE_READER</source>
        <extracomment>A device of the reader's: the program that shows friends. English: “Program that asks for friends”</extracomment>
        <translation>친구를 찾는 프로그램</translation>
    </message>
    <message>
        <source>DEVICE_BROWSER</source>
        <extracomment>A device of the reader's. English: “Browser”</extracomment>
        <translation>브라우저</translation>
    </message>
    <message>
        <source>DEVICE_THIS</source>
        <extracomment>A device of the reader's: the one in use. English: “This browser”</extracomment>
        <translation>이 브라우저</translation>
    </message>
    <message>
        <source>DEVICE_HEARD</source>
        <extracomment>Below a device; %@ is a day and time. English: “Last heard: %@”</extracomment>
        <translation>마지막 소식: %@</translation>
    </message>
    <message>
        <source>DEVICE_SINCE</source>
        <extracomment>Below a device; %@ is a day and time. English: “Since: %@”</extracomment>
        <translation>시작: %@</translation>
    </message>
    <message>
        <source>DEVICE_END</source>
        <extracomment>Button: the device may do nothing any more. English: “End”</extracomment>
        <translation>끝내기</translation>
    </message>
    <message>
        <source>DEVICE_END_SPOKEN</source>
        <extracomment>Spoken: the same button; %@ is the device and its day. English: “End: %@”</extracomment>
        <translation>끝내기: %@</translation>
    </message>
    <message>
        <source>DEVICE_ASK</source>
        <extracomment>Asks before DEVICE_END. English: “It sends nothing and sees nobody from then on, and what it began ends.”</extracomment>
        <translation>이후로는 아무것도 보내지 않고 아무도 보지 못하며, 시작한 것도 끝납니다.</translation>
    </message>
    <message>
        <source>SETTINGS_PLACES_KEPT</source>
        <extracomment>Label of a choice of durations. English: “My places are kept for”</extracomment>
        <translation>내 위치 보관 기간</translation>
    </message>
    <message>
        <source>SETTINGS_LOOKS_KEPT</source>
        <extracomment>Label of a choice of durations. English: “Who looked is kept for”</extracomment>
        <translation>본 사람 보관 기간</translation>
    </message>
    <message>
        <source>SETTINGS_ZONE</source>
        <extracomment>Label of a choice. English: “Time zone”</extracomment>
        <translation>시간대</translation>
    </message>
    <message>
        <source>SETTINGS_LANGUAGE</source>
        <extracomment>Label of a choice. English: “Language”</extracomment>
        <translation>언어</translation>
    </message>
    <message>
        <source>SAVED</source>
        <extracomment>After saving. English: “Saved.”</extracomment>
        <translation>저장되었습니다.</translation>
    </message>
    <message>
        <source>DELETE_ASK</source>
        <extracomment>Asks before everything about the reader is deleted. English: “Your places, rules, devices and the notes of who looked go for good. Phones of friends keep what they have shown.”</extracomment>
        <translation>위치, 규칙, 기기와 본 사람의 기록이 영구히 사라집니다. 친구의 휴대폰에 표시된 것은 남습니다.</translation>
    </message>
    <message>
        <source>DELETE_NOW</source>
        <extracomment>Button. English: “Delete everything”</extracomment>
        <translation>모두 삭제</translation>
    </message>
    <message>
        <source>DELETED</source>
        <extracomment>After everything was deleted. English: “Everything about you is deleted.”</extracomment>
        <translation>나에 관한 모든 것이 삭제되었습니다.</translation>
    </message>
    <message>
        <source>LINK_TITLE</source>
        <extracomment>Title of the page that a link opens. English: “Your own page”</extracomment>
        <translation>나의 페이지</translation>
    </message>
    <message>
        <source>LINK_TEXT</source>
        <extracomment>Below it. English: “This link works once. After that this browser stays signed in for 30 days.”</extracomment>
        <translation>이 링크는 한 번만 쓸 수 있습니다. 그 뒤 이 브라우저는 30일 동안 로그인되어 있습니다.</translation>
    </message>
    <message>
        <source>LINK_OPEN</source>
        <extracomment>Button. English: “Open my page”</extracomment>
        <translation>내 페이지 열기</translation>
    </message>
    <message>
        <source>LINK_SPENT</source>
        <extracomment>The link cannot be used any more. English: “This link has been used, or its 15 minutes are over. Ask for another one.”</extracomment>
        <translation>이미 쓴 링크이거나 15분이 지났습니다. 새로 요청하세요.</translation>
    </message>
    <message>
        <source>SIGNED_OUT</source>
        <extracomment>Title: nobody is signed in. English: “This page opens with a link.”</extracomment>
        <translation>이 페이지는 링크로 열립니다.</translation>
    </message>
    <message>
        <source>SIGNED_OUT_TEXT</source>
        <extracomment>Below it. English: “Whoever runs the service gives you one. It works once, for 15 minutes.”</extracomment>
        <translation>서비스를 운영하는 사람이 줍니다. 15분 동안 한 번 쓸 수 있습니다.</translation>
    </message>
    <message>
        <source>NO_SUCH_PAGE</source>
        <extracomment>Title. English: “There is no such page.”</extracomment>
        <translation>그런 페이지는 없습니다.</translation>
    </message>
    <message>
        <source>NOT_FROM_HERE</source>
        <extracomment>A form that another page sent. English: “This did not come from your own page. Nothing has changed.”</extracomment>
        <translation>내 페이지에서 온 것이 아닙니다. 아무것도 바뀌지 않았습니다.</translation>
    </message>
    <message>
        <source>NOT_KEPT</source>
        <extracomment>The service could not write. English: “It could not be kept just now. Nothing has changed; try again in a while.”</extracomment>
        <translation>지금은 저장할 수 없었습니다. 아무것도 바뀌지 않았으니 잠시 후 다시 시도하세요.</translation>
    </message>
    <message>
        <source>NOT_UNDERSTOOD</source>
        <extracomment>A form with something missing. English: “Something is missing there. Nothing has changed; go back and choose again.”</extracomment>
        <translation>빠진 것이 있습니다. 아무것도 바뀌지 않았으니 돌아가서 다시 고르세요.</translation>
    </message>
    <message>
        <source>TIME_WANTED</source>
        <extracomment>No time was given beside the choice of one. English: “Choose the time at which it ends.”</extracomment>
        <translation>끝나는 시각을 고르세요.</translation>
    </message>
    <message>
        <source>TO_MY_PAGE</source>
        <extracomment>Link. English: “To my page”</extracomment>
        <translation>내 페이지로</translation>
    </message>
    <message>
        <source>MY_PLACES</source>
        <extracomment>Row and title: places to which the reader gave names. English: “My places”</extracomment>
        <translation>내 장소</translation>
    </message>
    <message>
        <source>PLACE_NONE</source>
        <extracomment>No place has a name. English: “No place has a name yet.”</extracomment>
        <translation>아직 이름 붙인 장소가 없습니다.</translation>
    </message>
    <message>
        <source>PLACE_HERE</source>
        <extracomment>Heading and button. English: “Name the place where I am”</extracomment>
        <translation>지금 있는 곳에 이름 붙이기</translation>
    </message>
    <message>
        <source>PLACE_HERE_HINT</source>
        <extracomment>Below PLACE_HERE. English: “The place of your phone’s last message, and 150 metres around it.”</extracomment>
        <translation>휴대폰의 마지막 메시지 위치와 주변 150미터.</translation>
    </message>
    <message>
        <source>PLACE_NO_FIX</source>
        <extracomment>Instead of PLACE_HERE_HINT. English: “Your phone has sent no place yet.”</extracomment>
        <translation>휴대폰이 아직 위치를 보내지 않았습니다.</translation>
    </message>
    <message>
        <source>PLACE_NAME</source>
        <extracomment>Label of a field. English: “Name of the place”</extracomment>
        <translation>장소 이름</translation>
    </message>
    <message>
        <source>PLACE_SAID</source>
        <extracomment>Label of a box to tick, and below a place. English: “Friends may hear its name”</extracomment>
        <translation>친구가 이름을 들어도 됨</translation>
    </message>
    <message>
        <source>PLACE_UNSAID</source>
        <extracomment>Below a place. English: “Nobody hears its name”</extracomment>
        <translation>아무도 이름을 듣지 못함</translation>
    </message>
    <message>
        <source>PLACE_REMOVE</source>
        <extracomment>Button. English: “Remove”</extracomment>
        <translation>없애기</translation>
    </message>
    <message>
        <source>PLACE_REMOVE_ONE</source>
        <extracomment>Title, and spoken: the same button; %@ is the name of a place. English: “Remove: %@”</extracomment>
        <translation>없애기: %@</translation>
    </message>
    <message>
        <source>PLACE_REMOVE_ASK</source>
        <extracomment>Asks before PLACE_REMOVE. English: “Its name goes, and rules that were to end there end now.”</extracomment>
        <translation>이름이 사라지고, 거기서 끝나기로 한 규칙은 지금 끝납니다.</translation>
    </message>
    <message>
        <source>TOLD_MAY</source>
        <extracomment>Label of a switch: whether one person may be told when the reader comes and goes. English: “May be told when you come and go”</extracomment>
        <translation>오고 가는 것을 알려도 됨</translation>
    </message>
    <message>
        <source>TOLD_MAY_HINT</source>
        <extracomment>Below TOLD_MAY; %@ is EXACTLY, a choice on the same page. English: “Holds only with “%@”.”</extracomment>
        <translation>‘%@’일 때만 적용됩니다.</translation>
    </message>
    <message>
        <source>TOLD_TITLE</source>
        <extracomment>Title of the page that lists who is told when the reader comes and goes, and the way there. English: “Who is told when I come and go”</extracomment>
        <translation>내가 오고 가는 것을 아는 사람</translation>
    </message>
    <message>
        <source>TOLD_NOBODY</source>
        <extracomment>On the page TOLD_TITLE when the list is empty. English: “Nobody is told.”</extracomment>
        <translation>아무도 모릅니다.</translation>
    </message>
    <message>
        <source>TOLD_LEAVING</source>
        <extracomment>In a row with somebody's name: that person is told when the reader leaves %@, a place. English: “When I leave: %@”</extracomment>
        <translation>떠날 때: %@</translation>
    </message>
    <message>
        <source>TOLD_ARRIVING</source>
        <extracomment>In a row with somebody's name: that person is told when the reader arrives at %@, a place. English: “When I arrive: %@”</extracomment>
        <translation>도착할 때: %@</translation>
    </message>
    <message>
        <source>PLACE_CHANGE</source>
        <extracomment>Button beside a place of the reader’s own: opens a page that changes it. English: “Change”</extracomment>
        <translation>변경</translation>
    </message>
    <message>
        <source>PLACE_CHANGE_ONE</source>
        <extracomment>Title of that page, and the spoken name of that button; %@ is the place’s name. English: “Change %@”</extracomment>
        <translation>%@ 변경</translation>
    </message>
    <message>
        <source>PLACE_KIND</source>
        <extracomment>Label of a choice: what kind of place it is; below it PLACE_KIND_NONE, PLACE_KIND_HOME and so on. English: “Kind”</extracomment>
        <translation>종류</translation>
    </message>
    <message>
        <source>PLACE_KIND_NONE</source>
        <extracomment>In the choice PLACE_KIND: no kind. English: “None”</extracomment>
        <translation>없음</translation>
    </message>
    <message>
        <source>PLACE_KIND_HOME</source>
        <extracomment>In the choice PLACE_KIND. English: “Home”</extracomment>
        <translation>집</translation>
    </message>
    <message>
        <source>PLACE_KIND_WORK</source>
        <extracomment>In the choice PLACE_KIND. English: “Work”</extracomment>
        <translation>직장</translation>
    </message>
    <message>
        <source>PLACE_KIND_SCHOOL</source>
        <extracomment>In the choice PLACE_KIND. English: “School”</extracomment>
        <translation>학교</translation>
    </message>
    <message>
        <source>PLACE_KIND_GYM</source>
        <extracomment>In the choice PLACE_KIND. English: “Gym”</extracomment>
        <translation>체육관</translation>
    </message>
    <message>
        <source>PLACE_KIND_OTHER</source>
        <extracomment>In the choice PLACE_KIND. English: “Other”</extracomment>
        <translation>다른 장소</translation>
    </message>
    <message>
        <source>PLACE_TAKEN</source>
        <extracomment>Complaint when a place is given a name that another one has. English: “Another place of yours has this name.”</extracomment>
        <translation>같은 이름의 장소가 이미 있습니다.</translation>
    </message>
    <message>
        <source>NEAR_TOWN</source>
        <extracomment>Where somebody is: %1$@ is the nearest town in the nominative, %2$@ how far away it is (“40 km”). English: “near %1$@, %2$@”</extracomment>
        <translation>%1$@ 부근, %2$@</translation>
    </message>
    <message>
        <source>STREET_IN_TOWN</source>
        <extracomment>Where somebody is: %1$@ is a street, %2$@ its town; change their order where the language does. English: “%1$@, %2$@”</extracomment>
        <translation>%2$@ %1$@</translation>
    </message>
    <message>
        <source>COORDINATES</source>
        <extracomment>Where somebody is, where nothing has a name: %1$@ is DEGREES_NORTH or DEGREES_SOUTH, %2$@ DEGREES_EAST or DEGREES_WEST. English: “%1$@, %2$@”</extracomment>
        <translation>%1$@, %2$@</translation>
    </message>
    <message>
        <source>DEGREES_NORTH</source>
        <extracomment>A latitude; %@ is a number with two decimals. English: “%@° north”</extracomment>
        <translation>북위 %@°</translation>
    </message>
    <message>
        <source>DEGREES_SOUTH</source>
        <extracomment>A latitude; %@ is a number with two decimals. English: “%@° south”</extracomment>
        <translation>남위 %@°</translation>
    </message>
    <message>
        <source>DEGREES_EAST</source>
        <extracomment>A longitude; %@ is a number with two decimals. English: “%@° east”</extracomment>
        <translation>동경 %@°</translation>
    </message>
    <message>
        <source>DEGREES_WEST</source>
        <extracomment>A longitude; %@ is a number with two decimals. English: “%@° west”</extracomment>
        <translation>서경 %@°</translation>
    </message>
    <message>
        <source>LINK_COMPUTER</source>
        <extracomment>A button: makes a link with which the program on a computer signs in; and the title of the page that shows it. English: “Sign in on a computer”</extracomment>
        <translation>컴퓨터에서 로그인</translation>
    </message>
    <message>
        <source>LINK_COMPUTER_TEXT</source>
        <extracomment>Above the link. English: “Paste this link into ktr on the computer. It works once, within 15 minutes.”</extracomment>
        <translation>이 링크를 컴퓨터의 ktr에 붙여 넣으세요. 15분 안에 한 번만 쓸 수 있습니다.</translation>
    </message>
</context>
</TS>
