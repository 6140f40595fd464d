<?xml version="1.0" encoding="utf-8"?>
<!DOCTYPE TS>
<TS version="2.1" language="pl" sourcelanguage="en">
<context>
    <name>Localizable</name>
    <message>
        <source>TODAY</source>
        <extracomment>Above a question; %@ is the time of day. English: “Today, %@”</extracomment>
        <translation>Dzisiaj, %@</translation>
    </message>
    <message>
        <source>DISTANCE_TEXT</source>
        <extracomment>A frame around each distance (%@, with its unit), for a language that needs one; usually %@ alone. English: “%@”</extracomment>
        <translation>%@</translation>
    </message>
    <message>
        <source>_$!&lt;home&gt;!$_</source>
        <extracomment>A built-in name for a place. English: “Home”</extracomment>
        <translation>Dom</translation>
    </message>
    <message>
        <source>_$!&lt;work&gt;!$_</source>
        <extracomment>A built-in name for a place. English: “Work”</extracomment>
        <translation>Praca</translation>
    </message>
    <message>
        <source>_$!&lt;school&gt;!$_</source>
        <extracomment>A built-in name for a place. English: “School”</extracomment>
        <translation>Szkoła</translation>
    </message>
    <message>
        <source>_$!&lt;gym&gt;!$_</source>
        <extracomment>A built-in name for a place. English: “Gym”</extracomment>
        <translation>Siłownia</translation>
    </message>
    <message>
        <source>_$!&lt;other&gt;!$_</source>
        <extracomment>A built-in name for a place. English: “Other”</extracomment>
        <translation>Inne miejsce</translation>
    </message>
    <message>
        <source>ASK_FIELD</source>
        <extracomment>What stands in the empty field, and its name for a screen reader. English: “Ask about your friends”</extracomment>
        <translation>Zapytaj o znajomych</translation>
    </message>
    <message>
        <source>ASK_SEND</source>
        <extracomment>The button that sends the question. English: “Send”</extracomment>
        <translation>Wyślij</translation>
    </message>
    <message>
        <source>QUESTION_TOO_LONG</source>
        <extracomment>In place of an answer, where what was typed or pasted is too long to be a question</extracomment>
        <translation>To za długie na pytanie. Zadaj krótsze.</translation>
    </message>
    <message>
        <source>ASK_STOP</source>
        <extracomment>The same button, while an answer is waited for: it gives the question up. English: “Stop asking”</extracomment>
        <translation>Przestań pytać</translation>
    </message>
    <message>
        <source>ASKING_SLOW</source>
        <extracomment>In the answer’s place, when it takes more than four seconds. English: “Taking longer than usual…”</extracomment>
        <translation>To trwa dłużej niż zwykle…</translation>
    </message>
    <message>
        <source>STATUS_LIVE_NOW</source>
        <extracomment>Status line: answers keep coming. English: “Live · updated just now”</extracomment>
        <translation>Na żywo · zaktualizowano przed chwilą</translation>
    </message>
    <message>
        <source>STATUS_LIVE_SECONDS</source>
        <extracomment>The same; %@ is a number of seconds. English: “Live · updated %@ s ago”</extracomment>
        <translation>Na żywo · zaktualizowano %@ sek. temu</translation>
    </message>
    <message>
        <source>STATUS_LIVE_MINUTES</source>
        <extracomment>The same; %@ is a number of minutes. English: “Live · updated %@ min ago”</extracomment>
        <translation>Na żywo · zaktualizowano %@ min temu</translation>
    </message>
    <message>
        <source>STATUS_LIVE_HOURS</source>
        <extracomment>The same; %@ is a number of hours. English: “Live · updated %@ h ago”</extracomment>
        <translation>Na żywo · zaktualizowano %@ godz. temu</translation>
    </message>
    <message>
        <source>STATUS_PAUSED_NOW</source>
        <extracomment>Status line: no more answers come by themselves. English: “Paused · updated just now”</extracomment>
        <translation>Wstrzymano · zaktualizowano przed chwilą</translation>
    </message>
    <message>
        <source>STATUS_PAUSED_SECONDS</source>
        <extracomment>The same; %@ is a number of seconds. English: “Paused · updated %@ s ago”</extracomment>
        <translation>Wstrzymano · zaktualizowano %@ sek. temu</translation>
    </message>
    <message>
        <source>STATUS_PAUSED_MINUTES</source>
        <extracomment>The same; %@ is a number of minutes. English: “Paused · updated %@ min ago”</extracomment>
        <translation>Wstrzymano · zaktualizowano %@ min temu</translation>
    </message>
    <message>
        <source>STATUS_PAUSED_HOURS</source>
        <extracomment>The same; %@ is a number of hours. English: “Paused · updated %@ h ago”</extracomment>
        <translation>Wstrzymano · zaktualizowano %@ godz. temu</translation>
    </message>
    <message>
        <source>STATUS_FINDING_YOU</source>
        <extracomment>Status line: the user's own position is looked for. English: “Finding where you are…”</extracomment>
        <translation>Ustalanie Twojego położenia…</translation>
    </message>
    <message>
        <source>STATUS_HIDDEN</source>
        <extracomment>The status line while friends cannot see where the user is. English: “Your location is hidden”</extracomment>
        <translation>Twoje położenie jest ukryte</translation>
    </message>
    <message>
        <source>STATUS_ASKING</source>
        <extracomment>Status line: a question waits for its answer. English: “Asking…”</extracomment>
        <translation>Pytanie w toku…</translation>
    </message>
    <message>
        <source>STATUS_OFFLINE</source>
        <extracomment>Status line: the service cannot be reached, and nothing is on screen. English: “Offline.”</extracomment>
        <translation>Brak połączenia.</translation>
    </message>
    <message>
        <source>STATUS_OFFLINE_SINCE</source>
        <extracomment>The same with an answer on screen; %@ is the time of day when it was known. English: “Offline. Showing what was known at %@.”</extracomment>
        <translation>Brak połączenia. Dane z godziny %@.</translation>
    </message>
    <message>
        <source>STATUS_FAULTY</source>
        <extracomment>Status line: the service answers, but with an error, or not in its own words; nothing is on screen. English: “Service error.”</extracomment>
        <translation>Błąd usługi.</translation>
    </message>
    <message>
        <source>STATUS_FAULTY_SINCE</source>
        <extracomment>The same with an answer on screen; %@ is the time of day when it was known. English: “Service error. Showing what was known at %@.”</extracomment>
        <translation>Błąd usługi. Dane z godziny %@.</translation>
    </message>
    <message>
        <source>STATUS_UNTRUSTED</source>
        <extracomment>Status line: whoever answers cannot prove to be the service; nothing is on screen. English: “Service not trusted.”</extracomment>
        <translation>Usługa niezaufana.</translation>
    </message>
    <message>
        <source>STATUS_UNTRUSTED_SINCE</source>
        <extracomment>The same with an answer on screen; %@ is the time of day when it was known. English: “Service not trusted. Showing what was known at %@.”</extracomment>
        <translation>Usługa niezaufana. Dane z godziny %@.</translation>
    </message>
    <message>
        <source>STATUS_SIGN_IN</source>
        <extracomment>Status line: the service does not take the account's credentials, or there is no account. English: “Sign in again to see your friends.”</extracomment>
        <translation>Zaloguj się ponownie, aby zobaczyć znajomych.</translation>
    </message>
    <message>
        <source>STATUS_SIGN_IN_FIRST</source>
        <extracomment>Status line: nobody has signed in on this computer yet</extracomment>
        <translation>Zaloguj się, aby zobaczyć znajomych.</translation>
    </message>
    <message>
        <source>SIGN_IN_TITLE</source>
        <extracomment>Title of the page for signing in</extracomment>
        <translation>Gdzie są twoi znajomi?</translation>
    </message>
    <message>
        <source>SIGN_IN_LINE</source>
        <extracomment>Below that title</extracomment>
        <translation>Zaloguj się do usługi, w której udostępniacie miejsca. Może być twoja własna.</translation>
    </message>
    <message>
        <source>SIGN_IN_ADDRESS</source>
        <extracomment>Label of a field: the address of the service</extracomment>
        <translation>Adres usługi</translation>
    </message>
    <message>
        <source>SIGN_IN_YOU</source>
        <extracomment>Label of a field: who signs in</extracomment>
        <translation>Ty</translation>
    </message>
    <message>
        <source>SIGN_IN_SECRET</source>
        <extracomment>Label of a field: the password</extracomment>
        <translation>Sekret</translation>
    </message>
    <message>
        <source>SIGN_IN_GO</source>
        <extracomment>Button: signs in</extracomment>
        <translation>Zaloguj się</translation>
    </message>
    <message>
        <source>SIGN_IN_CHECKING</source>
        <extracomment>On that button while the service is asked</extracomment>
        <translation>Sprawdzanie…</translation>
    </message>
    <message>
        <source>SIGN_IN_CANCEL</source>
        <extracomment>Button: ends the asking</extracomment>
        <translation>Anuluj</translation>
    </message>
    <message>
        <source>SIGN_IN_RETRY</source>
        <extracomment>Button: asks again after nothing answered</extracomment>
        <translation>Spróbuj ponownie</translation>
    </message>
    <message>
        <source>SIGN_IN_SHOW</source>
        <extracomment>Spoken: a button that shows the letters of the secret</extracomment>
        <translation>Pokaż sekret</translation>
    </message>
    <message>
        <source>SIGN_IN_HIDE</source>
        <extracomment>Spoken: a button that hides them again</extracomment>
        <translation>Ukryj sekret</translation>
    </message>
    <message>
        <source>SIGN_IN_KEYRING</source>
        <extracomment>Small, below the fields</extracomment>
        <translation>Twój sekret pozostaje w bazie kluczy tego komputera.</translation>
    </message>
    <message>
        <source>SIGN_IN_UNKNOWN</source>
        <extracomment>Below the secret; does not tell which of the two is wrong</extracomment>
        <translation>Usługa nie zna tej osoby z tym sekretem. Sprawdź jedno i drugie albo poproś o nowy sekret.</translation>
    </message>
    <message>
        <source>SIGN_IN_NOTHING_ANSWERS</source>
        <extracomment>Below the address, which is %@</extracomment>
        <translation>Pod adresem %@ nic nie odpowiada. Sprawdź adres i połączenie tego komputera.</translation>
    </message>
    <message>
        <source>SIGN_IN_NOT_TRUSTED</source>
        <extracomment>Below the address, which is %@: its certificate is not valid</extracomment>
        <translation>To, co odpowiada pod adresem %@, nie może dowieść, że jest twoją usługą, więc nic nie wysłano.</translation>
    </message>
    <message>
        <source>SIGN_IN_NO_SERVICE</source>
        <extracomment>Below the address, which is %@: it is some other web server</extracomment>
        <translation>Pod adresem %@ odpowiada coś innego. Sprawdź adres.</translation>
    </message>
    <message>
        <source>SIGN_IN_FAILING</source>
        <extracomment>Below the address, which is %@: the service reports a failure of its own</extracomment>
        <translation>%@ nie może teraz pomóc.</translation>
    </message>
    <message>
        <source>SIGN_IN_BAD_ADDRESS</source>
        <extracomment>Below the address; keep brin.example as it is</extracomment>
        <translation>Adres wygląda tak: brin.example.</translation>
    </message>
    <message>
        <source>SIGN_IN_LOCKED</source>
        <extracomment>The system's keyring is locked or missing</extracomment>
        <translation>Baza kluczy jest zamknięta. Odblokuj ją albo zachowaj sekret w pliku, który tylko ty możesz odczytać.</translation>
    </message>
    <message>
        <source>SIGN_IN_UNLOCK</source>
        <extracomment>Button: tries the keyring again</extracomment>
        <translation>Odblokuj bazę kluczy</translation>
    </message>
    <message>
        <source>SIGN_IN_IN_FILE</source>
        <extracomment>Button: keeps the secret in a file instead of the keyring</extracomment>
        <translation>Zachowaj w pliku</translation>
    </message>
    <message>
        <source>SIGN_IN_NOT_WRITTEN</source>
        <extracomment>The configuration cannot be written</extracomment>
        <translation>Ustawień nie można zapisać na tym komputerze.</translation>
    </message>
    <message>
        <source>GREETING_MORNING</source>
        <extracomment>Title of an empty conversation</extracomment>
        <translation>Dzień dobry.</translation>
    </message>
    <message>
        <source>GREETING_AFTERNOON</source>
        <extracomment>Title of an empty conversation</extracomment>
        <translation>Dzień dobry.</translation>
    </message>
    <message>
        <source>GREETING_EVENING</source>
        <extracomment>Title of an empty conversation</extracomment>
        <translation>Dobry wieczór.</translation>
    </message>
    <message>
        <source>GREETING_LINE</source>
        <extracomment>Below that title</extracomment>
        <translation>Zapytaj o znajomych albo dotknij pytania.</translation>
    </message>
    <message>
        <source>SUGGEST_FRIENDS</source>
        <extracomment>A question that is asked by a tap</extracomment>
        <translation>Gdzie są moi znajomi?</translation>
    </message>
    <message>
        <source>SUGGEST_NEAR</source>
        <extracomment>A question that is asked by a tap</extracomment>
        <translation>Kto jest blisko mnie?</translation>
    </message>
    <message>
        <source>SUGGEST_HIDE</source>
        <extracomment>A wish that is asked for by a tap</extracomment>
        <translation>Ukryj moje położenie</translation>
    </message>
    <message>
        <source>ANSWER_UNREACHABLE</source>
        <extracomment>Below a question that nobody answered. English: “Your assistant is out of reach right now.”</extracomment>
        <translation>Twój asystent jest teraz nieosiągalny.</translation>
    </message>
    <message>
        <source>ANSWER_SIGN_IN</source>
        <extracomment>Below a question that was asked without an account. English: “Sign in to ask about your friends.”</extracomment>
        <translation>Zaloguj się, aby zapytać o znajomych.</translation>
    </message>
    <message>
        <source>ANSWER_NOT_SHOWN</source>
        <extracomment>Below a question whose answer is of a kind that cannot be shown. English: “This answer cannot be shown here.”</extracomment>
        <translation>Tej odpowiedzi nie można tutaj pokazać.</translation>
    </message>
    <message>
        <source>ANSWER_RESTRICTED</source>
        <extracomment>Below a question, while the device allows no friends’ locations. English: “Friends’ locations are switched off on this device.”</extracomment>
        <translation>Położenia znajomych są wyłączone na tym urządzeniu.</translation>
    </message>
    <message>
        <source>STATUS_UNREADABLE</source>
        <extracomment>Status line: the configuration is broken. English: “Your settings cannot be read.”</extracomment>
        <translation>Nie można odczytać Twoich ustawień.</translation>
    </message>
    <message>
        <source>MAP_NOT_AVAILABLE</source>
        <extracomment>In place of a map that nobody can draw. English: “Map not available”</extracomment>
        <translation>Mapa niedostępna</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_LINK</source>
        <extracomment>What a screen reader would say, written down: %@ can be opened. English: “%@ (link)”</extracomment>
        <translation>%@ (łącze)</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_IMAGE</source>
        <extracomment>The same: %@ describes a picture. English: “%@ (image)”</extracomment>
        <translation>%@ (obraz)</translation>
    </message>
    <message>
        <source>ANNOUNCE_QUESTION</source>
        <extracomment>A screen reader’s name for what the user asked. English: “Question”</extracomment>
        <translation>Pytanie</translation>
    </message>
    <message>
        <source>ANNOUNCE_ANSWER</source>
        <extracomment>A screen reader’s name for the sentence that answers. English: “Answer”</extracomment>
        <translation>Odpowiedź</translation>
    </message>
    <message>
        <source>ANNOUNCE_PEOPLE</source>
        <extracomment>Said after the sentence of an answer that has come: %@ is how many people are on it. English: “People: %@.”</extracomment>
        <translation>Osoby: %@.</translation>
    </message>
    <message>
        <source>ANNOUNCE_PLACE</source>
        <extracomment>Said when a friend (%1$@) has come to another place (%2$@, such as “Fish Market”, “Home” or “Brinmouth, HB”). English: “%1$@: %2$@.”</extracomment>
        <translation>%1$@: %2$@.</translation>
    </message>
    <message>
        <source>ANNOUNCE_UNSEEN</source>
        <extracomment>Said when the place of a friend (%@) is not told any more. English: “%@ is no longer visible.”</extracomment>
        <translation>%@: położenie nie jest już widoczne.</translation>
    </message>
    <message>
        <source>ANNOUNCE_SEEN</source>
        <extracomment>Said when the place (%2$@) of a friend (%1$@) is known again. English: “%1$@ is visible again: %2$@.”</extracomment>
        <translation>%1$@: położenie znów widoczne: %2$@.</translation>
    </message>
    <message>
        <source>ANNOUNCE_SEEN_SOMEWHERE</source>
        <extracomment>The same for a place without a name. English: “%@ is visible again.”</extracomment>
        <translation>%@: położenie znów widoczne.</translation>
    </message>
    <message>
        <source>ANNOUNCE_UNREACHABLE</source>
        <extracomment>Said when the friends’ service cannot be reached any more. English: “Your friends are out of reach. What is shown may be old.”</extracomment>
        <translation>Nie można połączyć się ze znajomymi. Wyświetlane dane mogą być nieaktualne.</translation>
    </message>
    <message>
        <source>ANNOUNCE_REACHABLE</source>
        <extracomment>Said when it can be reached again. English: “Your friends are within reach again.”</extracomment>
        <translation>Znajomi są znów osiągalni.</translation>
    </message>
    <message>
        <source>ANNOUNCE_NEXT</source>
        <extracomment>Two sentences that are said one after the other, as the language parts them; each has its full stop. English: “%1$@ %2$@”</extracomment>
        <translation>%1$@ %2$@</translation>
    </message>
    <message>
        <source>LINK_NOBODY</source>
        <extracomment>A tap on a link that no program opens</extracomment>
        <translation>Żaden program na tym komputerze nie otwiera linków.</translation>
    </message>
    <message>
        <source>PLACE_NOBODY</source>
        <extracomment>The same, of a place on the map</extracomment>
        <translation>Żaden program na tym komputerze nie otwiera miejsc.</translation>
    </message>
    <message>
        <source>CALL_NOBODY</source>
        <extracomment>The same, of a call</extracomment>
        <translation>Żaden program na tym komputerze nie dzwoni.</translation>
    </message>
    <message>
        <source>WRITE_NOBODY</source>
        <extracomment>The same, of a message</extracomment>
        <translation>Żaden program na tym komputerze nie pisze wiadomości.</translation>
    </message>
    <message>
        <source>LINK_REFUSED</source>
        <extracomment>A link of a kind that this program does not open</extracomment>
        <translation>Ten link nie otwiera się tutaj.</translation>
    </message>
    <message>
        <source>LINK_UNKNOWN</source>
        <extracomment>A link from elsewhere about nobody who is among the user’s friends</extracomment>
        <translation>Nie wiem, o kim jest ten link.</translation>
    </message>
    <message>
        <source>FRIEND_CALL</source>
        <extracomment>Under a round button: calls the friend</extracomment>
        <translation>Zadzwoń</translation>
    </message>
    <message>
        <source>FRIEND_WRITE</source>
        <extracomment>Under a round button: writes to the friend</extracomment>
        <translation>Napisz</translation>
    </message>
    <message>
        <source>FRIEND_MAPS</source>
        <extracomment>Under a round button: opens the place in a program for maps</extracomment>
        <translation>Otwórz w mapach</translation>
    </message>
    <message>
        <source>FRIEND_COPY</source>
        <extracomment>Under a round button: puts the place into the clipboard</extracomment>
        <translation>Kopiuj miejsce</translation>
    </message>
    <message>
        <source>FRIEND_COPIED</source>
        <extracomment>In the place of “Copy place”, for two seconds after it was pressed</extracomment>
        <translation>Skopiowano</translation>
    </message>
    <message>
        <source>FRIEND_SHOW</source>
        <extracomment>A button: brings the friend (%@) back into view on the map</extracomment>
        <translation>Pokaż: %@</translation>
    </message>
    <message>
        <source>FRIEND_WHERE</source>
        <extracomment>A button that asks where a friend (%@) is</extracomment>
        <translation>Gdzie jest %@?</translation>
    </message>
    <message>
        <source>FRIEND_NOT_SEEN</source>
        <extracomment>A friend (%@) whose place is not to be seen</extracomment>
        <translation>Nie widzę, gdzie jest %@.</translation>
    </message>
    <message>
        <source>MAP_CLOSER</source>
        <extracomment>A button on the map, spoken: zooms in</extracomment>
        <translation>Bliżej</translation>
    </message>
    <message>
        <source>MAP_FURTHER</source>
        <extracomment>A button on the map, spoken: zooms out</extracomment>
        <translation>Dalej</translation>
    </message>
    <message>
        <source>MAP_SPOKEN</source>
        <extracomment>The map of a friend’s page, spoken; %@ is the friend</extracomment>
        <translation>Mapa okolicy: %@</translation>
    </message>
    <message>
        <source>HOW_FEW</source>
        <extracomment>How exactly a place is known: up to 15 metres</extracomment>
        <translation>Z dokładnością do kilku metrów</translation>
    </message>
    <message>
        <source>HOW_WITHIN</source>
        <extracomment>The same; %@ is a distance with its unit</extracomment>
        <translation>Z dokładnością do około %@</translation>
    </message>
    <message>
        <source>HOW_NEAR</source>
        <extracomment>The same, of a wide place; %@ is a distance with its unit</extracomment>
        <translation>Gdzieś w pobliżu, z dokładnością do około %@</translation>
    </message>
    <message>
        <source>PAGE_FRIENDS</source>
        <extracomment>The name of the page with the list of friends</extracomment>
        <translation>Znajomi</translation>
    </message>
    <message>
        <source>PAGE_FRIENDS_NONE</source>
        <extracomment>On that page, when nobody was asked about</extracomment>
        <translation>Jeszcze o nikogo nie pytano.</translation>
    </message>
    <message>
        <source>PAGE_ME</source>
        <extracomment>The name of the user’s own page</extracomment>
        <translation>Moje miejsce</translation>
    </message>
    <message>
        <source>SHARING_SWITCH</source>
        <extracomment>A switch on that page</extracomment>
        <translation>Znajomi mnie widzą</translation>
    </message>
    <message>
        <source>SHARING_ON</source>
        <extracomment>Under that switch, while it is on</extracomment>
        <translation>Osoby, którym pozwalasz, widzą, gdzie jesteś.</translation>
    </message>
    <message>
        <source>SHARING_OFF</source>
        <extracomment>Under that switch, while it is off</extracomment>
        <translation>Nikt nie widzi, gdzie jesteś.</translation>
    </message>
    <message>
        <source>SHARING_UNKNOWN</source>
        <extracomment>Under that switch, while the service has not been told anything by it</extracomment>
        <translation>Twoja usługa jeszcze tego nie powiedziała.</translation>
    </message>
    <message>
        <source>SHARING_FAILED</source>
        <extracomment>Under that switch, when the wish did not reach the service</extracomment>
        <translation>Twoja usługa nie odpowiedziała. Tutaj nic się nie zmieniło.</translation>
    </message>
    <message>
        <source>MAP_NO_STREETS</source>
        <extracomment>Under a card whose map has no streets</extracomment>
        <translation>Nie ma tu jeszcze ulic tego regionu.</translation>
    </message>
    <message>
        <source>MAP_GET_STREETS</source>
        <extracomment>Beside it, a button: chooses a file with a map</extracomment>
        <translation>Pobierz ulice</translation>
    </message>
    <message>
        <source>MAP_NO_PLACE</source>
        <extracomment>On the plain ground of a map whose friend has no place</extracomment>
        <translation>Brak miejsca</translation>
    </message>
    <message>
        <source>MENU_CUT</source>
        <extracomment>In the menu of the field</extracomment>
        <translation>Wytnij</translation>
    </message>
    <message>
        <source>MENU_COPY</source>
        <extracomment>In the menu of the field and of the conversation</extracomment>
        <translation>Kopiuj</translation>
    </message>
    <message>
        <source>MENU_PASTE</source>
        <extracomment>In the menu of the field</extracomment>
        <translation>Wklej</translation>
    </message>
    <message>
        <source>MENU_SELECT_ALL</source>
        <extracomment>In the menu of the field</extracomment>
        <translation>Zaznacz wszystko</translation>
    </message>
    <message>
        <source>WATCH_ARRIVAL</source>
        <extracomment>A notification about a friend, below the name: the friend has arrived at %@, a place with a name, or a time such as 17:42. English: “Arrived: %@”</extracomment>
        <translation>Przybycie: %@</translation>
    </message>
    <message>
        <source>WATCH_DEPARTURE</source>
        <extracomment>A notification about a friend, below the name: the friend has left %@, a place with a name, or a time such as 17:42. English: “Left: %@”</extracomment>
        <translation>Wyjście: %@</translation>
    </message>
    <message>
        <source>WATCH_SOMEBODY_ARRIVED</source>
        <extracomment>A notification while the screen is locked: it says neither who nor where. English: “Somebody arrived”</extracomment>
        <translation>Ktoś przybył</translation>
    </message>
    <message>
        <source>WATCH_SOMEBODY_LEFT</source>
        <extracomment>A notification while the screen is locked: it says neither who nor where. English: “Somebody left”</extracomment>
        <translation>Ktoś wyszedł</translation>
        <source>PAGE_BACK</source>
        <extracomment>The way back from a page, spoken</extracomment>
        <translation>Wstecz</translation>
    </message>
    <message>
        <source>SETTINGS</source>
        <extracomment>The name of the page with the user’s settings, and spoken of the button that opens it. English: “Settings”</extracomment>
        <translation>Ustawienia</translation>
    </message>
    <message>
        <source>SETTINGS_SIGN_OUT</source>
        <extracomment>A button on that page. English: “Sign out”</extracomment>
        <translation>Wyloguj się</translation>
    </message>
    <message>
        <source>SETTINGS_SHARING</source>
        <extracomment>The name of a section of that page. English: “Sharing”</extracomment>
        <translation>Udostępnianie</translation>
    </message>
    <message>
        <source>SETTINGS_WHO</source>
        <extracomment>Leads to the service’s own page in a browser. English: “Who sees what”</extracomment>
        <translation>Kto co widzi</translation>
    </message>
    <message>
        <source>SETTINGS_READING</source>
        <extracomment>The name of a section. English: “Reading”</extracomment>
        <translation>Czytanie</translation>
    </message>
    <message>
        <source>SETTINGS_TEXT_SIZE</source>
        <extracomment>A setting; its value is one of the sizes below. English: “Text size”</extracomment>
        <translation>Rozmiar tekstu</translation>
    </message>
    <message>
        <source>SETTINGS_SMALLER</source>
        <extracomment>Spoken: a button beside it. English: “Smaller text”</extracomment>
        <translation>Mniejszy tekst</translation>
    </message>
    <message>
        <source>SETTINGS_LARGER</source>
        <extracomment>Spoken: a button beside it. English: “Larger text”</extracomment>
        <translation>Większy tekst</translation>
    </message>
    <message>
        <source>SIZE_XS</source>
        <extracomment>A text size. English: “Smallest”</extracomment>
        <translation>Najmniejszy</translation>
    </message>
    <message>
        <source>SIZE_S</source>
        <extracomment>A text size. English: “Smaller”</extracomment>
        <translation>Mniejszy</translation>
    </message>
    <message>
        <source>SIZE_M</source>
        <extracomment>A text size. English: “Small”</extracomment>
        <translation>Mały</translation>
    </message>
    <message>
        <source>SIZE_L</source>
        <extracomment>A text size. English: “Standard”</extracomment>
        <translation>Zwykły</translation>
    </message>
    <message>
        <source>SIZE_XL</source>
        <extracomment>A text size. English: “Large”</extracomment>
        <translation>Duży</translation>
    </message>
    <message>
        <source>SIZE_XXL</source>
        <extracomment>A text size. English: “Larger”</extracomment>
        <translation>Większy</translation>
    </message>
    <message>
        <source>SIZE_XXXL</source>
        <extracomment>A text size. English: “Largest”</extracomment>
        <translation>Największy</translation>
    </message>
    <message>
        <source>SIZE_AX</source>
        <extracomment>A text size beyond the largest; %@ is a number from 1 to 5. English: “Very large %@”</extracomment>
        <translation>Bardzo duży %@</translation>
    </message>
    <message>
        <source>SETTINGS_COLORS</source>
        <extracomment>A setting; its value is one of the following. English: “Colours”</extracomment>
        <translation>Kolory</translation>
    </message>
    <message>
        <source>SETTINGS_AS_SYSTEM</source>
        <extracomment>The value of a setting that follows the desktop. English: “As the system”</extracomment>
        <translation>Jak w systemie</translation>
    </message>
    <message>
        <source>COLORS_LIGHT</source>
        <extracomment>Of the colours. English: “Light”</extracomment>
        <translation>Jasne</translation>
    </message>
    <message>
        <source>COLORS_DARK</source>
        <extracomment>Of the colours. English: “Dark”</extracomment>
        <translation>Ciemne</translation>
    </message>
    <message>
        <source>COLORS_HIGH</source>
        <extracomment>Of the colours. English: “High contrast”</extracomment>
        <translation>Wysoki kontrast</translation>
    </message>
    <message>
        <source>SETTINGS_DISTANCES</source>
        <extracomment>A setting; its value is one of the following. English: “Distances”</extracomment>
        <translation>Odległości</translation>
    </message>
    <message>
        <source>DISTANCES_METRIC</source>
        <extracomment>Of the distances. English: “Kilometres”</extracomment>
        <translation>Kilometry</translation>
    </message>
    <message>
        <source>DISTANCES_MILES</source>
        <extracomment>Of the distances. English: “Miles”</extracomment>
        <translation>Mile</translation>
    </message>
    <message>
        <source>SETTINGS_LANGUAGE</source>
        <extracomment>A setting; its value is the name of a language. English: “Language”</extracomment>
        <translation>Język</translation>
    </message>
    <message>
        <source>SETTINGS_CONTACTS</source>
        <extracomment>The name of a section: what this computer adds to answers. English: “Contacts and position”</extracomment>
        <translation>Kontakty i położenie</translation>
    </message>
    <message>
        <source>SETTINGS_BOOKS</source>
        <extracomment>A switch: the desktop’s address books. English: “Address books”</extracomment>
        <translation>Książki adresowe</translation>
    </message>
    <message>
        <source>SETTINGS_BOOKS_LINE</source>
        <extracomment>Under that switch. English: “Names and faces come from them.”</extracomment>
        <translation>Stąd są imiona i zdjęcia.</translation>
    </message>
    <message>
        <source>SETTINGS_POSITION</source>
        <extracomment>A switch: where the user’s computer is. English: “My position”</extracomment>
        <translation>Moje położenie</translation>
    </message>
    <message>
        <source>SETTINGS_POSITION_LINE</source>
        <extracomment>Under that switch. English: “Distances are counted from it.”</extracomment>
        <translation>Stąd liczone są odległości.</translation>
    </message>
    <message>
        <source>SETTINGS_WATCH</source>
        <extracomment>A switch on the page with settings: notifications of friends who come and go</extracomment>
        <translation>Powiadomienia</translation>
    </message>
    <message>
        <source>SETTINGS_WATCH_LINE</source>
        <extracomment>Under that switch</extracomment>
        <translation>Gdy znajomi wychodzą lub docierają, zgodnie z prośbą.</translation>
    </message>
    <message>
        <source>SETTINGS_WATCH_NONE</source>
        <extracomment>Under that switch, in the place of its line, where the computer cannot run anything in the background</extracomment>
        <translation>Nic nie może tu działać w tle.</translation>
    </message>
    <message>
        <source>SETTINGS_MAPS</source>
        <extracomment>The name of a section. English: “Maps”</extracomment>
        <translation>Mapy</translation>
    </message>
    <message>
        <source>MAPS_WORLD</source>
        <extracomment>A map that is always there. English: “The world”</extracomment>
        <translation>Świat</translation>
    </message>
    <message>
        <source>MAPS_WORLD_LINE</source>
        <extracomment>Under its name. English: “Towns, borders and large roads”</extracomment>
        <translation>Miasta, granice i duże drogi</translation>
    </message>
    <message>
        <source>MAPS_STREETS</source>
        <extracomment>Under the name of a map with streets; %@ is the size of its file, such as “12 MB”. English: “Streets, %@”</extracomment>
        <translation>Ulice, %@</translation>
    </message>
    <message>
        <source>MAPS_ADD</source>
        <extracomment>Opens a dialog that chooses a file with a map. English: “Add a region”</extracomment>
        <translation>Dodaj region</translation>
    </message>
    <message>
        <source>MAPS_REMOVE</source>
        <extracomment>A button: the map is not drawn any more. English: “Remove this map”</extracomment>
        <translation>Usuń tę mapę</translation>
    </message>
    <message>
        <source>MAPS_REFUSED</source>
        <extracomment>Said when a chosen file is no map. English: “This file isn’t a map that can be drawn.”</extracomment>
        <translation>Ten plik nie jest mapą, którą da się narysować.</translation>
    </message>
    <message>
        <source>SETTINGS_HELP</source>
        <extracomment>The name of a section. English: “Help”</extracomment>
        <translation>Pomoc</translation>
    </message>
    <message>
        <source>SETTINGS_SET_FOR_YOU</source>
        <extracomment>Under a setting that an administrator or the command line holds. English: “Set for you”</extracomment>
        <translation>Ustawione za ciebie</translation>
    </message>
    <message>
        <source>STATUS_TRY_NOW</source>
        <extracomment>A button at the end of the status line while the service cannot be reached. English: “Try now”</extracomment>
        <translation>Spróbuj teraz</translation>
    </message>
    <message>
        <source>PAGE_FRIENDS_SHARE</source>
        <extracomment>On the page with the list of friends: a section with those who let the user see where they are. English: “They share with you”</extracomment>
        <translation>Udostępniają ci</translation>
    </message>
    <message>
        <source>SIGN_IN_HAVE_LINK</source>
        <extracomment>A button on the page for signing in: asks for a link instead. English: “I have a link”</extracomment>
        <translation>Mam link</translation>
    </message>
    <message>
        <source>SIGN_IN_USE_SECRET</source>
        <extracomment>A button there: asks for address, person and secret again. English: “Use address and secret”</extracomment>
        <translation>Użyj adresu i sekretu</translation>
    </message>
    <message>
        <source>SIGN_IN_LINK</source>
        <extracomment>Label of a field: a link that signs in. English: “Link”</extracomment>
        <translation>Link</translation>
    </message>
    <message>
        <source>SIGN_IN_LINK_LINE</source>
        <extracomment>Below the title, above that field. English: “Paste the link you were given. It works once.”</extracomment>
        <translation>Wklej otrzymany link. Działa raz.</translation>
    </message>
    <message>
        <source>SIGN_IN_LINK_SPENT</source>
        <extracomment>Below the link; the service does not tell which of the two it is. English: “This link was used, or is too old. Ask for a new one.”</extracomment>
        <translation>Ten link był użyty albo jest za stary. Poproś o nowy.</translation>
    </message>
    <message>
        <source>SIGN_IN_BAD_LINK</source>
        <extracomment>Below the link. English: “This isn’t a link for signing in.”</extracomment>
        <translation>To nie jest link do logowania.</translation>
    </message>
    <message>
        <source>SIGN_IN_ALREADY</source>
        <extracomment>Said when a link that signs in comes while somebody is signed in. English: “You are signed in. Sign out first to use this link.”</extracomment>
        <translation>Jesteś już po zalogowaniu. Aby użyć tego linku, najpierw się wyloguj.</translation>
    </message>
    <message>
        <source>CHECK_UP</source>
        <extracomment>The name of the page that says what is wrong and what mends it. English: “Check-up”</extracomment>
        <translation>Przegląd</translation>
    </message>
    <message>
        <source>CHECK_WELL</source>
        <extracomment>Title of that page when nothing is wrong. English: “All is well.”</extracomment>
        <translation>Wszystko w porządku.</translation>
    </message>
    <message>
        <source>CHECK_NOW</source>
        <extracomment>Below that title. English: “Checked just now.”</extracomment>
        <translation>Sprawdzono przed chwilą.</translation>
    </message>
    <message>
        <source>CHECK_REST</source>
        <extracomment>Below the title when something is wrong. English: “Everything else is fine. Checked just now.”</extracomment>
        <translation>Cała reszta jest w porządku. Sprawdzono przed chwilą.</translation>
    </message>
    <message>
        <source>CHECK_HANDS</source>
        <extracomment>Title when something is wrong; %@ is how many things. English: “{0, plural, one{One thing needs a hand.} other{%@ things need a hand.}}”</extracomment>
        <translation>{0, plural, one{Jedna rzecz wymaga pomocy.} few{%@ rzeczy wymagają pomocy.} many{%@ rzeczy wymaga pomocy.} other{%@ rzeczy wymaga pomocy.}}</translation>
    </message>
    <message>
        <source>CHECK_FINE</source>
        <extracomment>The name of the section with what is in order. English: “Fine”</extracomment>
        <translation>W porządku</translation>
    </message>
    <message>
        <source>CHECK_AGAIN</source>
        <extracomment>A button. English: “Check again”</extracomment>
        <translation>Sprawdź ponownie</translation>
    </message>
    <message>
        <source>CHECK_REPORT</source>
        <extracomment>A button. English: “Copy report”</extracomment>
        <translation>Kopiuj raport</translation>
    </message>
    <message>
        <source>CHECK_COMMAND</source>
        <extracomment>A button: puts the command that mends a thing into the clipboard, for a terminal. English: “Copy the command”</extracomment>
        <translation>Kopiuj polecenie</translation>
    </message>
    <message>
        <source>CHECK_SIGN_IN_AGAIN</source>
        <extracomment>A button. English: “Sign in again”</extracomment>
        <translation>Zaloguj się ponownie</translation>
    </message>
    <message>
        <source>CHECK_SET_CLOCK</source>
        <extracomment>A button. English: “Set the clock”</extracomment>
        <translation>Ustaw zegar</translation>
    </message>
    <message>
        <source>CHECK_ASK_AGAIN</source>
        <extracomment>A button: asks the address book again. English: “Ask it again”</extracomment>
        <translation>Zapytaj ponownie</translation>
    </message>
    <message>
        <source>CHECK_ACCOUNT</source>
        <extracomment>A thing that is fine. English: “Account”</extracomment>
        <translation>Konto</translation>
    </message>
    <message>
        <source>CHECK_SERVICE</source>
        <extracomment>A thing that is fine. English: “Service”</extracomment>
        <translation>Usługa</translation>
    </message>
    <message>
        <source>CHECK_CLOCK</source>
        <extracomment>A thing that is fine. English: “Clock”</extracomment>
        <translation>Zegar</translation>
    </message>
    <message>
        <source>CHECK_CONTACTS</source>
        <extracomment>A thing that is fine: files with contacts. English: “Contacts”</extracomment>
        <translation>Kontakty</translation>
    </message>
    <message>
        <source>CHECK_LETTERS</source>
        <extracomment>A thing that is fine: fonts for all scripts. English: “Letters”</extracomment>
        <translation>Litery</translation>
    </message>
    <message>
        <source>CHECK_READER</source>
        <extracomment>A thing that is fine. English: “Screen reader”</extracomment>
        <translation>Czytnik ekranu</translation>
    </message>
    <message>
        <source>CHECK_DESKTOP</source>
        <extracomment>A thing that is fine: what the desktop offers to programs. English: “Desktop”</extracomment>
        <translation>Pulpit</translation>
    </message>
    <message>
        <source>CHECK_NOBODY</source>
        <extracomment>A thing that is wrong. English: “Nobody is signed in.”</extracomment>
        <translation>Nikt nie jest zalogowany.</translation>
    </message>
    <message>
        <source>CHECK_LOCKED</source>
        <extracomment>A thing that is wrong. English: “The keyring is locked.”</extracomment>
        <translation>Baza kluczy jest zablokowana.</translation>
    </message>
    <message>
        <source>CHECK_LOCKED_LINE</source>
        <extracomment>Its cause. English: “Your secret can’t be read, so nobody is asked until it is open.”</extracomment>
        <translation>Nie można odczytać sekretu, więc do otwarcia nikt nie jest pytany.</translation>
    </message>
    <message>
        <source>CHECK_UNREACHABLE</source>
        <extracomment>A thing that is wrong. English: “The service can’t be reached.”</extracomment>
        <translation>Usługa jest nieosiągalna.</translation>
    </message>
    <message>
        <source>CHECK_UNREACHABLE_LINE</source>
        <extracomment>Its cause; %@ is an address. English: “Nothing answers at %@.”</extracomment>
        <translation>Nic nie odpowiada pod %@.</translation>
    </message>
    <message>
        <source>CHECK_REDIRECT_LINE</source>
        <extracomment>Another cause. English: “An address is remembered that isn’t your service’s.”</extracomment>
        <translation>Zapamiętano adres, który nie należy do twojej usługi.</translation>
    </message>
    <message>
        <source>CHECK_UNKNOWN</source>
        <extracomment>A thing that is wrong. English: “The service doesn’t know you any more.”</extracomment>
        <translation>Usługa już cię nie zna.</translation>
    </message>
    <message>
        <source>CHECK_CLOCKS</source>
        <extracomment>A thing that is wrong. English: “The clocks disagree.”</extracomment>
        <translation>Zegary się nie zgadzają.</translation>
    </message>
    <message>
        <source>CHECK_AHEAD</source>
        <extracomment>Its cause; %@ is a number of minutes. English: “This computer is %@ min ahead of the service, so ages are wrong.”</extracomment>
        <translation>Ten komputer spieszy się o %@ min względem usługi, więc podawany wiek jest błędny.</translation>
    </message>
    <message>
        <source>CHECK_BEHIND</source>
        <extracomment>Its cause; %@ is a number of minutes. English: “This computer is %@ min behind the service, so ages are wrong.”</extracomment>
        <translation>Ten komputer spóźnia się o %@ min względem usługi, więc podawany wiek jest błędny.</translation>
    </message>
    <message>
        <source>CHECK_BOOKS_SILENT</source>
        <extracomment>A thing that is wrong. English: “Your address book is silent.”</extracomment>
        <translation>Twoja książka adresowa milczy.</translation>
    </message>
    <message>
        <source>CHECK_BOOKS_LINE</source>
        <extracomment>Its cause. English: “It hasn’t answered. Names come from the service for now.”</extracomment>
        <translation>Nie odpowiedziała. Na razie imiona pochodzą z usługi.</translation>
    </message>
    <message>
        <source>CHECK_NO_CONTACTS</source>
        <extracomment>A thing that is wrong. English: “Your contacts can’t be read.”</extracomment>
        <translation>Nie można odczytać twoich kontaktów.</translation>
    </message>
    <message>
        <source>CHECK_FILE_LINE</source>
        <extracomment>A cause: of contacts, of a map, of the settings. English: “A file is missing or broken.”</extracomment>
        <translation>Brakuje pliku albo jest uszkodzony.</translation>
    </message>
    <message>
        <source>CHECK_NOWHERE</source>
        <extracomment>A thing that is wrong. English: “Nobody knows where you are.”</extracomment>
        <translation>Nikt nie wie, gdzie jesteś.</translation>
    </message>
    <message>
        <source>CHECK_NOWHERE_LINE</source>
        <extracomment>Its cause. English: “This computer has no position, so there are no distances.”</extracomment>
        <translation>Ten komputer nie ma położenia, więc nie ma odległości.</translation>
    </message>
    <message>
        <source>CHECK_NO_MAP</source>
        <extracomment>A thing that is wrong. English: “A map can’t be drawn.”</extracomment>
        <translation>Nie można narysować mapy.</translation>
    </message>
    <message>
        <source>CHECK_NO_LETTERS</source>
        <extracomment>A thing that is wrong. English: “Letters are missing.”</extracomment>
        <translation>Brakuje liter.</translation>
    </message>
    <message>
        <source>CHECK_LETTERS_LINE</source>
        <extracomment>Its cause. English: “Some names show as boxes.”</extracomment>
        <translation>Niektóre imiona widać jako kwadraty.</translation>
    </message>
    <message>
        <source>CHECK_DEAF</source>
        <extracomment>A thing that is wrong. English: “Screen readers can’t listen.”</extracomment>
        <translation>Czytniki ekranu nie mogą słuchać.</translation>
    </message>
    <message>
        <source>CHECK_DEAF_LINE</source>
        <extracomment>Its cause. English: “What joins them to programs doesn’t answer.”</extracomment>
        <translation>To, co łączy je z programami, nie odpowiada.</translation>
    </message>
    <message>
        <source>CHECK_NO_DESKTOP</source>
        <extracomment>A thing that is wrong. English: “The desktop doesn’t answer.”</extracomment>
        <translation>Pulpit nie odpowiada.</translation>
    </message>
    <message>
        <source>CHECK_NO_DESKTOP_LINE</source>
        <extracomment>Its cause. English: “Its colours and contrast aren’t followed, and links may not open.”</extracomment>
        <translation>Jego kolory i kontrast nie są brane pod uwagę, a linki mogą się nie otwierać.</translation>
    </message>
    <message>
        <source>SHARING_REFUSED</source>
        <extracomment>Under that switch, when the service does not do this. English: “Your service can’t change this here.”</extracomment>
        <translation>Twoja usługa nie może tego tu zmienić.</translation>
    </message>
</context>
</TS>
