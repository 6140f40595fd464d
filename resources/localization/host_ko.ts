<?xml version="1.0" encoding="utf-8"?>
<!DOCTYPE TS>
<TS version="2.1" language="ko" sourcelanguage="en">
<context>
    <name>Localizable</name>
    <message>
        <source>TODAY</source>
        <extracomment>Above a question; %@ is the time of day. English: “Today, %@”</extracomment>
        <translation>오늘, %@</translation>
    </message>
    <message>
        <source>DISTANCE_TEXT</source>
        <extracomment>A frame around each distance (%@, with its unit), for a language that needs one; usually %@ alone. English: “%@”</extracomment>
        <translation>%@</translation>
    </message>
    <message>
        <source>_$!&lt;home&gt;!$_</source>
        <extracomment>A built-in name for a place. English: “Home”</extracomment>
        <translation>집</translation>
    </message>
    <message>
        <source>_$!&lt;work&gt;!$_</source>
        <extracomment>A built-in name for a place. English: “Work”</extracomment>
        <translation>직장</translation>
    </message>
    <message>
        <source>_$!&lt;school&gt;!$_</source>
        <extracomment>A built-in name for a place. English: “School”</extracomment>
        <translation>학교</translation>
    </message>
    <message>
        <source>_$!&lt;gym&gt;!$_</source>
        <extracomment>A built-in name for a place. English: “Gym”</extracomment>
        <translation>체육관</translation>
    </message>
    <message>
        <source>_$!&lt;other&gt;!$_</source>
        <extracomment>A built-in name for a place. English: “Other”</extracomment>
        <translation>다른 장소</translation>
    </message>
    <message>
        <source>ASK_FIELD</source>
        <extracomment>What stands in the empty field, and its name for a screen reader. English: “Ask about your friends”</extracomment>
        <translation>친구에 대해 물어보기</translation>
    </message>
    <message>
        <source>ASK_SEND</source>
        <extracomment>The button that sends the question. English: “Send”</extracomment>
        <translation>보내기</translation>
    </message>
    <message>
        <source>STATUS_LIVE_NOW</source>
        <extracomment>Status line: answers keep coming. English: “Live · updated just now”</extracomment>
        <translation>실시간 · 방금 업데이트됨</translation>
    </message>
    <message>
        <source>STATUS_LIVE_SECONDS</source>
        <extracomment>The same; %@ is a number of seconds. English: “Live · updated %@ s ago”</extracomment>
        <translation>실시간 · %@초 전 업데이트됨</translation>
    </message>
    <message>
        <source>STATUS_LIVE_MINUTES</source>
        <extracomment>The same; %@ is a number of minutes. English: “Live · updated %@ min ago”</extracomment>
        <translation>실시간 · %@분 전 업데이트됨</translation>
    </message>
    <message>
        <source>STATUS_LIVE_HOURS</source>
        <extracomment>The same; %@ is a number of hours. English: “Live · updated %@ h ago”</extracomment>
        <translation>실시간 · %@시간 전 업데이트됨</translation>
    </message>
    <message>
        <source>STATUS_PAUSED_NOW</source>
        <extracomment>Status line: no more answers come by themselves. English: “Paused · updated just now”</extracomment>
        <translation>일시 중지됨 · 방금 업데이트됨</translation>
    </message>
    <message>
        <source>STATUS_PAUSED_SECONDS</source>
        <extracomment>The same; %@ is a number of seconds. English: “Paused · updated %@ s ago”</extracomment>
        <translation>일시 중지됨 · %@초 전 업데이트됨</translation>
    </message>
    <message>
        <source>STATUS_PAUSED_MINUTES</source>
        <extracomment>The same; %@ is a number of minutes. English: “Paused · updated %@ min ago”</extracomment>
        <translation>일시 중지됨 · %@분 전 업데이트됨</translation>
    </message>
    <message>
        <source>STATUS_PAUSED_HOURS</source>
        <extracomment>The same; %@ is a number of hours. English: “Paused · updated %@ h ago”</extracomment>
        <translation>일시 중지됨 · %@시간 전 업데이트됨</translation>
    </message>
    <message>
        <source>STATUS_FINDING_YOU</source>
        <extracomment>Status line: the user's own position is looked for. English: “Finding where you are…”</extracomment>
        <translation>내 위치를 찾는 중…</translation>
    </message>
    <message>
        <source>STATUS_HIDDEN</source>
        <extracomment>The status line while friends cannot see where the user is. English: “Your location is hidden”</extracomment>
        <translation>내 위치가 숨겨져 있음</translation>
    </message>
    <message>
        <source>STATUS_ASKING</source>
        <extracomment>Status line: a question waits for its answer. English: “Asking…”</extracomment>
        <translation>질문하는 중…</translation>
    </message>
    <message>
        <source>STATUS_OFFLINE</source>
        <extracomment>Status line: the service cannot be reached, and nothing is on screen. English: “Offline.”</extracomment>
        <translation>오프라인입니다.</translation>
    </message>
    <message>
        <source>STATUS_OFFLINE_SINCE</source>
        <extracomment>The same with an answer on screen; %@ is the time of day when it was known. English: “Offline. Showing what was known at %@.”</extracomment>
        <translation>오프라인입니다. 마지막으로 확인된 정보: %@.</translation>
    </message>
    <message>
        <source>STATUS_FAULTY</source>
        <extracomment>Status line: the service answers, but with an error, or not in its own words; nothing is on screen. English: “Service error.”</extracomment>
        <translation>서비스 오류입니다.</translation>
    </message>
    <message>
        <source>STATUS_FAULTY_SINCE</source>
        <extracomment>The same with an answer on screen; %@ is the time of day when it was known. English: “Service error. Showing what was known at %@.”</extracomment>
        <translation>서비스 오류입니다. 마지막으로 확인된 정보: %@.</translation>
    </message>
    <message>
        <source>STATUS_UNTRUSTED</source>
        <extracomment>Status line: whoever answers cannot prove to be the service; nothing is on screen. English: “Service not trusted.”</extracomment>
        <translation>서비스를 신뢰할 수 없습니다.</translation>
    </message>
    <message>
        <source>STATUS_UNTRUSTED_SINCE</source>
        <extracomment>The same with an answer on screen; %@ is the time of day when it was known. English: “Service not trusted. Showing what was known at %@.”</extracomment>
        <translation>서비스를 신뢰할 수 없습니다. 마지막으로 확인된 정보: %@.</translation>
    </message>
    <message>
        <source>STATUS_SIGN_IN</source>
        <extracomment>Status line: the service does not take the account's credentials, or there is no account. English: “Sign in again to see your friends.”</extracomment>
        <translation>친구를 보려면 다시 로그인하세요.</translation>
    </message>
    <message>
        <source>ANSWER_UNREACHABLE</source>
        <extracomment>Below a question that nobody answered. English: “Your assistant is out of reach right now.”</extracomment>
        <translation>지금은 어시스턴트에 연결할 수 없습니다.</translation>
    </message>
    <message>
        <source>ANSWER_SIGN_IN</source>
        <extracomment>Below a question that was asked without an account. English: “Sign in to ask about your friends.”</extracomment>
        <translation>친구에 대해 물어보려면 로그인하세요.</translation>
    </message>
    <message>
        <source>ANSWER_NOT_SHOWN</source>
        <extracomment>Below a question whose answer is of a kind that cannot be shown. English: “This answer cannot be shown here.”</extracomment>
        <translation>이 답변은 여기에 표시할 수 없습니다.</translation>
    </message>
    <message>
        <source>ANSWER_RESTRICTED</source>
        <extracomment>Below a question, while the device allows no friends’ locations. English: “Friends’ locations are switched off on this device.”</extracomment>
        <translation>이 기기에서는 친구 위치가 꺼져 있습니다.</translation>
    </message>
    <message>
        <source>STATUS_UNREADABLE</source>
        <extracomment>Status line: the configuration is broken. English: “Your settings cannot be read.”</extracomment>
        <translation>설정을 읽을 수 없습니다.</translation>
    </message>
    <message>
        <source>MAP_NOT_AVAILABLE</source>
        <extracomment>In place of a map that nobody can draw. English: “Map not available”</extracomment>
        <translation>지도를 사용할 수 없음</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_LINK</source>
        <extracomment>What a screen reader would say, written down: %@ can be opened. English: “%@ (link)”</extracomment>
        <translation>%@(링크)</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_IMAGE</source>
        <extracomment>The same: %@ describes a picture. English: “%@ (image)”</extracomment>
        <translation>%@(이미지)</translation>
    </message>
    <message>
        <source>ANNOUNCE_QUESTION</source>
        <extracomment>A screen reader’s name for what the user asked. English: “Question”</extracomment>
        <translation>질문</translation>
    </message>
    <message>
        <source>ANNOUNCE_ANSWER</source>
        <extracomment>A screen reader’s name for the sentence that answers. English: “Answer”</extracomment>
        <translation>답변</translation>
    </message>
    <message>
        <source>ANNOUNCE_PEOPLE</source>
        <extracomment>Said after the sentence of an answer that has come: %@ is how many people are on it. English: “People: %@.”</extracomment>
        <translation>인원: %@.</translation>
    </message>
    <message>
        <source>ANNOUNCE_PLACE</source>
        <extracomment>Said when a friend (%1$@) has come to another place (%2$@, such as “Fish Market”, “Home” or “Brinmouth, HB”). English: “%1$@: %2$@.”</extracomment>
        <translation>%1$@: %2$@.</translation>
    </message>
    <message>
        <source>ANNOUNCE_UNSEEN</source>
        <extracomment>Said when the place of a friend (%@) is not told any more. English: “%@ is no longer visible.”</extracomment>
        <translation>%@ 님의 위치가 더 이상 보이지 않습니다.</translation>
    </message>
    <message>
        <source>ANNOUNCE_SEEN</source>
        <extracomment>Said when the place (%2$@) of a friend (%1$@) is known again. English: “%1$@ is visible again: %2$@.”</extracomment>
        <translation>%1$@ 님의 위치가 다시 보입니다: %2$@.</translation>
    </message>
    <message>
        <source>ANNOUNCE_SEEN_SOMEWHERE</source>
        <extracomment>The same for a place without a name. English: “%@ is visible again.”</extracomment>
        <translation>%@ 님의 위치가 다시 보입니다.</translation>
    </message>
    <message>
        <source>ANNOUNCE_UNREACHABLE</source>
        <extracomment>Said when the friends’ service cannot be reached any more. English: “Your friends are out of reach. What is shown may be old.”</extracomment>
        <translation>친구 정보를 가져올 수 없습니다. 표시된 내용이 오래되었을 수 있습니다.</translation>
    </message>
    <message>
        <source>ANNOUNCE_REACHABLE</source>
        <extracomment>Said when it can be reached again. English: “Your friends are within reach again.”</extracomment>
        <translation>친구 정보를 다시 가져올 수 있습니다.</translation>
    </message>
    <message>
        <source>ANNOUNCE_NEXT</source>
        <extracomment>Two sentences that are said one after the other, as the language parts them; each has its full stop. English: “%1$@ %2$@”</extracomment>
        <translation>%1$@ %2$@</translation>
    </message>
    <message>
        <source>LINK_NOBODY</source>
        <extracomment>A tap on a link that no program opens</extracomment>
        <translation>이 컴퓨터에는 링크를 여는 프로그램이 없습니다.</translation>
    </message>
    <message>
        <source>PLACE_NOBODY</source>
        <extracomment>The same, of a place on the map</extracomment>
        <translation>이 컴퓨터에는 장소를 여는 프로그램이 없습니다.</translation>
    </message>
    <message>
        <source>CALL_NOBODY</source>
        <extracomment>The same, of a call</extracomment>
        <translation>이 컴퓨터에는 전화를 거는 프로그램이 없습니다.</translation>
    </message>
    <message>
        <source>WRITE_NOBODY</source>
        <extracomment>The same, of a message</extracomment>
        <translation>이 컴퓨터에는 메시지를 쓰는 프로그램이 없습니다.</translation>
    </message>
    <message>
        <source>LINK_REFUSED</source>
        <extracomment>A link of a kind that this program does not open</extracomment>
        <translation>이 링크는 여기서 열 수 없습니다.</translation>
    </message>
    <message>
        <source>LINK_UNKNOWN</source>
        <extracomment>A link from elsewhere about nobody who is among the user’s friends</extracomment>
        <translation>이 링크가 누구에 관한 것인지 모릅니다.</translation>
    </message>
    <message>
        <source>FRIEND_CALL</source>
        <extracomment>Under a round button: calls the friend</extracomment>
        <translation>전화</translation>
    </message>
    <message>
        <source>FRIEND_WRITE</source>
        <extracomment>Under a round button: writes to the friend</extracomment>
        <translation>쓰기</translation>
    </message>
    <message>
        <source>FRIEND_MAPS</source>
        <extracomment>Under a round button: opens the place in a program for maps</extracomment>
        <translation>지도에서 열기</translation>
    </message>
    <message>
        <source>FRIEND_COPY</source>
        <extracomment>Under a round button: puts the place into the clipboard</extracomment>
        <translation>장소 복사</translation>
    </message>
    <message>
        <source>FRIEND_COPIED</source>
        <extracomment>In the place of “Copy place”, for two seconds after it was pressed</extracomment>
        <translation>복사됨</translation>
    </message>
    <message>
        <source>FRIEND_SHOW</source>
        <extracomment>A button: brings the friend (%@) back into view on the map</extracomment>
        <translation>%@ 보기</translation>
    </message>
    <message>
        <source>FRIEND_WHERE</source>
        <extracomment>A button that asks where a friend (%@) is</extracomment>
        <translation>%@ 님은 어디에 있나요?</translation>
    </message>
    <message>
        <source>FRIEND_NOT_SEEN</source>
        <extracomment>A friend (%@) whose place is not to be seen</extracomment>
        <translation>%@ 님이 어디에 있는지 볼 수 없습니다.</translation>
    </message>
    <message>
        <source>MAP_CLOSER</source>
        <extracomment>A button on the map, spoken: zooms in</extracomment>
        <translation>더 가까이</translation>
    </message>
    <message>
        <source>MAP_FURTHER</source>
        <extracomment>A button on the map, spoken: zooms out</extracomment>
        <translation>더 멀리</translation>
    </message>
    <message>
        <source>MAP_SPOKEN</source>
        <extracomment>The map of a friend’s page, spoken; %@ is the friend</extracomment>
        <translation>%@ 주변 지도</translation>
    </message>
    <message>
        <source>HOW_FEW</source>
        <extracomment>How exactly a place is known: up to 15 metres</extracomment>
        <translation>몇 미터 이내</translation>
    </message>
    <message>
        <source>HOW_WITHIN</source>
        <extracomment>The same; %@ is a distance with its unit</extracomment>
        <translation>약 %@ 이내</translation>
    </message>
    <message>
        <source>HOW_NEAR</source>
        <extracomment>The same, of a wide place; %@ is a distance with its unit</extracomment>
        <translation>근처 어딘가, 약 %@ 이내</translation>
    </message>
    <message>
        <source>PAGE_FRIENDS</source>
        <extracomment>The name of the page with the list of friends</extracomment>
        <translation>친구</translation>
    </message>
    <message>
        <source>PAGE_FRIENDS_NONE</source>
        <extracomment>On that page, when nobody was asked about</extracomment>
        <translation>아직 아무에 대해서도 묻지 않았습니다.</translation>
    </message>
    <message>
        <source>PAGE_ME</source>
        <extracomment>The name of the user’s own page</extracomment>
        <translation>내 위치</translation>
    </message>
    <message>
        <source>SHARING_SWITCH</source>
        <extracomment>A switch on that page</extracomment>
        <translation>친구가 나를 볼 수 있음</translation>
    </message>
    <message>
        <source>SHARING_ON</source>
        <extracomment>Under that switch, while it is on</extracomment>
        <translation>허용한 사람은 내가 어디에 있는지 볼 수 있습니다.</translation>
    </message>
    <message>
        <source>SHARING_OFF</source>
        <extracomment>Under that switch, while it is off</extracomment>
        <translation>아무도 내가 어디에 있는지 볼 수 없습니다.</translation>
    </message>
    <message>
        <source>SHARING_UNKNOWN</source>
        <extracomment>Under that switch, while the service has not been told anything by it</extracomment>
        <translation>서비스가 아직 알려 주지 않았습니다.</translation>
    </message>
    <message>
        <source>SHARING_FAILED</source>
        <extracomment>Under that switch, when the wish did not reach the service</extracomment>
        <translation>서비스가 응답하지 않았습니다. 여기서는 아무것도 바뀌지 않았습니다.</translation>
    </message>
    <message>
        <source>MAP_NO_STREETS</source>
        <extracomment>Under a card whose map has no streets</extracomment>
        <translation>이 지역의 거리가 아직 없습니다.</translation>
    </message>
    <message>
        <source>MAP_GET_STREETS</source>
        <extracomment>Beside it, a button: chooses a file with a map</extracomment>
        <translation>거리 가져오기</translation>
    </message>
    <message>
        <source>MAP_NO_PLACE</source>
        <extracomment>On the plain ground of a map whose friend has no place</extracomment>
        <translation>장소 없음</translation>
    </message>
    <message>
        <source>MENU_CUT</source>
        <extracomment>In the menu of the field</extracomment>
        <translation>잘라내기</translation>
    </message>
    <message>
        <source>MENU_COPY</source>
        <extracomment>In the menu of the field and of the conversation</extracomment>
        <translation>복사</translation>
    </message>
    <message>
        <source>MENU_PASTE</source>
        <extracomment>In the menu of the field</extracomment>
        <translation>붙여넣기</translation>
    </message>
    <message>
        <source>MENU_SELECT_ALL</source>
        <extracomment>In the menu of the field</extracomment>
        <translation>모두 선택</translation>
    </message>
    <message>
        <source>WATCH_ARRIVAL</source>
        <extracomment>A notification about a friend, below the name: the friend has arrived at %@, a place with a name, or a time such as 17:42. English: “Arrived: %@”</extracomment>
        <translation>도착: %@</translation>
    </message>
    <message>
        <source>WATCH_DEPARTURE</source>
        <extracomment>A notification about a friend, below the name: the friend has left %@, a place with a name, or a time such as 17:42. English: “Left: %@”</extracomment>
        <translation>출발: %@</translation>
    </message>
    <message>
        <source>WATCH_SOMEBODY_ARRIVED</source>
        <extracomment>A notification while the screen is locked: it says neither who nor where. English: “Somebody arrived”</extracomment>
        <translation>누군가 도착했습니다</translation>
    </message>
    <message>
        <source>WATCH_SOMEBODY_LEFT</source>
        <extracomment>A notification while the screen is locked: it says neither who nor where. English: “Somebody left”</extracomment>
        <translation>누군가 떠났습니다</translation>
    </message>
</context>
</TS>
