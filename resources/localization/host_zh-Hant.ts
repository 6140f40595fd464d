<?xml version="1.0" encoding="utf-8"?>
<!DOCTYPE TS>
<TS version="2.1" language="zh_TW" sourcelanguage="en">
<context>
    <name>Localizable</name>
    <message>
        <source>TODAY</source>
        <extracomment>Above a question; %@ is the time of day. English: “Today, %@”</extracomment>
        <translation>今天 %@</translation>
    </message>
    <message>
        <source>DISTANCE_TEXT</source>
        <extracomment>A frame around each distance (%@, with its unit), for a language that needs one; usually %@ alone. English: “%@”</extracomment>
        <translation>%@</translation>
    </message>
    <message>
        <source>_$!&lt;home&gt;!$_</source>
        <extracomment>A built-in name for a place. English: “Home”</extracomment>
        <translation>住家</translation>
    </message>
    <message>
        <source>_$!&lt;work&gt;!$_</source>
        <extracomment>A built-in name for a place. English: “Work”</extracomment>
        <translation>工作地點</translation>
    </message>
    <message>
        <source>_$!&lt;school&gt;!$_</source>
        <extracomment>A built-in name for a place. English: “School”</extracomment>
        <translation>學校</translation>
    </message>
    <message>
        <source>_$!&lt;gym&gt;!$_</source>
        <extracomment>A built-in name for a place. English: “Gym”</extracomment>
        <translation>健身房</translation>
    </message>
    <message>
        <source>_$!&lt;other&gt;!$_</source>
        <extracomment>A built-in name for a place. English: “Other”</extracomment>
        <translation>其他地點</translation>
    </message>
    <message>
        <source>ASK_FIELD</source>
        <extracomment>What stands in the empty field, and its name for a screen reader. English: “Ask about your friends”</extracomment>
        <translation>詢問朋友的位置</translation>
    </message>
    <message>
        <source>ASK_SEND</source>
        <extracomment>The button that sends the question. English: “Send”</extracomment>
        <translation>傳送</translation>
    </message>
    <message>
        <source>QUESTION_TOO_LONG</source>
        <extracomment>In place of an answer, where what was typed or pasted is too long to be a question</extracomment>
        <translation>作為問題太長了。請問得短一些。</translation>
    </message>
    <message>
        <source>ASK_STOP</source>
        <extracomment>The same button, while an answer is waited for: it gives the question up. English: “Stop asking”</extracomment>
        <translation>停止詢問</translation>
    </message>
    <message>
        <source>ASKING_SLOW</source>
        <extracomment>In the answer’s place, when it takes more than four seconds. English: “Taking longer than usual…”</extracomment>
        <translation>花的時間比平常長…</translation>
    </message>
    <message>
        <source>STATUS_LIVE_NOW</source>
        <extracomment>Status line: answers keep coming. English: “Live · updated just now”</extracomment>
        <translation>即時 · 剛剛更新</translation>
    </message>
    <message>
        <source>STATUS_LIVE_SECONDS</source>
        <extracomment>The same; %@ is a number of seconds. English: “Live · updated %@ s ago”</extracomment>
        <translation>即時 · %@ 秒前更新</translation>
    </message>
    <message>
        <source>STATUS_LIVE_MINUTES</source>
        <extracomment>The same; %@ is a number of minutes. English: “Live · updated %@ min ago”</extracomment>
        <translation>即時 · %@ 分鐘前更新</translation>
    </message>
    <message>
        <source>STATUS_LIVE_HOURS</source>
        <extracomment>The same; %@ is a number of hours. English: “Live · updated %@ h ago”</extracomment>
        <translation>即時 · %@ 小時前更新</translation>
    </message>
    <message>
        <source>STATUS_PAUSED_NOW</source>
        <extracomment>Status line: no more answers come by themselves. English: “Paused · updated just now”</extracomment>
        <translation>已暫停 · 剛剛更新</translation>
    </message>
    <message>
        <source>STATUS_PAUSED_SECONDS</source>
        <extracomment>The same; %@ is a number of seconds. English: “Paused · updated %@ s ago”</extracomment>
        <translation>已暫停 · %@ 秒前更新</translation>
    </message>
    <message>
        <source>STATUS_PAUSED_MINUTES</source>
        <extracomment>The same; %@ is a number of minutes. English: “Paused · updated %@ min ago”</extracomment>
        <translation>已暫停 · %@ 分鐘前更新</translation>
    </message>
    <message>
        <source>STATUS_PAUSED_HOURS</source>
        <extracomment>The same; %@ is a number of hours. English: “Paused · updated %@ h ago”</extracomment>
        <translation>已暫停 · %@ 小時前更新</translation>
    </message>
    <message>
        <source>STATUS_FINDING_YOU</source>
        <extracomment>Status line: the user's own position is looked for. English: “Finding where you are…”</extracomment>
        <translation>正在尋找你的位置…</translation>
    </message>
    <message>
        <source>STATUS_HIDDEN</source>
        <extracomment>The status line while friends cannot see where the user is. English: “Your location is hidden”</extracomment>
        <translation>你的位置已隱藏</translation>
    </message>
    <message>
        <source>STATUS_ASKING</source>
        <extracomment>Status line: a question waits for its answer. English: “Asking…”</extracomment>
        <translation>正在詢問…</translation>
    </message>
    <message>
        <source>STATUS_OFFLINE</source>
        <extracomment>Status line: the service cannot be reached, and nothing is on screen. English: “Offline.”</extracomment>
        <translation>離線。</translation>
    </message>
    <message>
        <source>STATUS_OFFLINE_SINCE</source>
        <extracomment>The same with an answer on screen; %@ is the time of day when it was known. English: “Offline. Showing what was known at %@.”</extracomment>
        <translation>離線。顯示的是 %@ 的資訊。</translation>
    </message>
    <message>
        <source>STATUS_FAULTY</source>
        <extracomment>Status line: the service answers, but with an error, or not in its own words; nothing is on screen. English: “Service error.”</extracomment>
        <translation>服務發生錯誤。</translation>
    </message>
    <message>
        <source>STATUS_FAULTY_SINCE</source>
        <extracomment>The same with an answer on screen; %@ is the time of day when it was known. English: “Service error. Showing what was known at %@.”</extracomment>
        <translation>服務發生錯誤。顯示的是 %@ 的資訊。</translation>
    </message>
    <message>
        <source>STATUS_UNTRUSTED</source>
        <extracomment>Status line: whoever answers cannot prove to be the service; nothing is on screen. English: “Service not trusted.”</extracomment>
        <translation>服務不受信任。</translation>
    </message>
    <message>
        <source>STATUS_UNTRUSTED_SINCE</source>
        <extracomment>The same with an answer on screen; %@ is the time of day when it was known. English: “Service not trusted. Showing what was known at %@.”</extracomment>
        <translation>服務不受信任。顯示的是 %@ 的資訊。</translation>
    </message>
    <message>
        <source>STATUS_SIGN_IN</source>
        <extracomment>Status line: the service does not take the account's credentials, or there is no account. English: “Sign in again to see your friends.”</extracomment>
        <translation>請重新登入以查看你的朋友。</translation>
    </message>
    <message>
        <source>STATUS_SIGN_IN_FIRST</source>
        <extracomment>Status line: nobody has signed in on this computer yet</extracomment>
        <translation>登入後即可查看朋友。</translation>
    </message>
    <message>
        <source>SIGN_IN_TITLE</source>
        <extracomment>Title of the page for signing in</extracomment>
        <translation>你的朋友在哪裡？</translation>
    </message>
    <message>
        <source>SIGN_IN_LINE</source>
        <extracomment>Below that title</extracomment>
        <translation>登入你們分享位置的服務，也可以是你自己的服務。</translation>
    </message>
    <message>
        <source>SIGN_IN_ADDRESS</source>
        <extracomment>Label of a field: the address of the service</extracomment>
        <translation>服務位址</translation>
    </message>
    <message>
        <source>SIGN_IN_YOU</source>
        <extracomment>Label of a field: who signs in</extracomment>
        <translation>你</translation>
    </message>
    <message>
        <source>SIGN_IN_SECRET</source>
        <extracomment>Label of a field: the password</extracomment>
        <translation>密鑰</translation>
    </message>
    <message>
        <source>SIGN_IN_GO</source>
        <extracomment>Button: signs in</extracomment>
        <translation>登入</translation>
    </message>
    <message>
        <source>SIGN_IN_CHECKING</source>
        <extracomment>On that button while the service is asked</extracomment>
        <translation>正在檢查…</translation>
    </message>
    <message>
        <source>SIGN_IN_CANCEL</source>
        <extracomment>Button: ends the asking</extracomment>
        <translation>取消</translation>
    </message>
    <message>
        <source>SIGN_IN_RETRY</source>
        <extracomment>Button: asks again after nothing answered</extracomment>
        <translation>再試一次</translation>
    </message>
    <message>
        <source>SIGN_IN_SHOW</source>
        <extracomment>Spoken: a button that shows the letters of the secret</extracomment>
        <translation>顯示密鑰</translation>
    </message>
    <message>
        <source>SIGN_IN_HIDE</source>
        <extracomment>Spoken: a button that hides them again</extracomment>
        <translation>隱藏密鑰</translation>
    </message>
    <message>
        <source>SIGN_IN_KEYRING</source>
        <extracomment>Small, below the fields</extracomment>
        <translation>你的密鑰保存在這部電腦的鑰匙圈中。</translation>
    </message>
    <message>
        <source>SIGN_IN_UNKNOWN</source>
        <extracomment>Below the secret; does not tell which of the two is wrong</extracomment>
        <translation>服務不認得此人與此密鑰的組合。請檢查兩者，或索取新的密鑰。</translation>
    </message>
    <message>
        <source>SIGN_IN_NOTHING_ANSWERS</source>
        <extracomment>Below the address, which is %@</extracomment>
        <translation>%@ 沒有回應。請檢查位址，以及這部電腦是否連線。</translation>
    </message>
    <message>
        <source>SIGN_IN_NOT_TRUSTED</source>
        <extracomment>Below the address, which is %@: its certificate is not valid</extracomment>
        <translation>%@ 的回應者無法證明它是你的服務，因此沒有傳送任何內容。</translation>
    </message>
    <message>
        <source>SIGN_IN_NO_SERVICE</source>
        <extracomment>Below the address, which is %@: it is some other web server</extracomment>
        <translation>%@ 的回應來自別的服務。請檢查位址。</translation>
    </message>
    <message>
        <source>SIGN_IN_FAILING</source>
        <extracomment>Below the address, which is %@: the service reports a failure of its own</extracomment>
        <translation>%@ 現在無法提供協助。</translation>
    </message>
    <message>
        <source>SIGN_IN_BAD_ADDRESS</source>
        <extracomment>Below the address; keep brin.example as it is</extracomment>
        <translation>服務位址的形式類似 brin.example。</translation>
    </message>
    <message>
        <source>SIGN_IN_LOCKED</source>
        <extracomment>The system's keyring is locked or missing</extracomment>
        <translation>鑰匙圈已鎖定。請解鎖，或將密鑰保存在只有你能讀取的檔案中。</translation>
    </message>
    <message>
        <source>SIGN_IN_UNLOCK</source>
        <extracomment>Button: tries the keyring again</extracomment>
        <translation>解鎖鑰匙圈</translation>
    </message>
    <message>
        <source>SIGN_IN_IN_FILE</source>
        <extracomment>Button: keeps the secret in a file instead of the keyring</extracomment>
        <translation>保存到檔案</translation>
    </message>
    <message>
        <source>SIGN_IN_NOT_WRITTEN</source>
        <extracomment>The configuration cannot be written</extracomment>
        <translation>你的設定無法保存在這部電腦上。</translation>
    </message>
    <message>
        <source>GREETING_MORNING</source>
        <extracomment>Title of an empty conversation</extracomment>
        <translation>早安。</translation>
    </message>
    <message>
        <source>GREETING_AFTERNOON</source>
        <extracomment>Title of an empty conversation</extracomment>
        <translation>午安。</translation>
    </message>
    <message>
        <source>GREETING_EVENING</source>
        <extracomment>Title of an empty conversation</extracomment>
        <translation>晚安。</translation>
    </message>
    <message>
        <source>GREETING_LINE</source>
        <extracomment>Below that title</extracomment>
        <translation>問問朋友的情況，或點一個問題。</translation>
    </message>
    <message>
        <source>SUGGEST_FRIENDS</source>
        <extracomment>A question that is asked by a tap</extracomment>
        <translation>我的朋友在哪裡？</translation>
    </message>
    <message>
        <source>SUGGEST_NEAR</source>
        <extracomment>A question that is asked by a tap</extracomment>
        <translation>誰在我附近？</translation>
    </message>
    <message>
        <source>SUGGEST_HIDE</source>
        <extracomment>A wish that is asked for by a tap</extracomment>
        <translation>隱藏我的位置</translation>
    </message>
    <message>
        <source>ANSWER_UNREACHABLE</source>
        <extracomment>Below a question that nobody answered. English: “Your assistant is out of reach right now.”</extracomment>
        <translation>目前無法連線到你的助理。</translation>
    </message>
    <message>
        <source>ANSWER_SIGN_IN</source>
        <extracomment>Below a question that was asked without an account. English: “Sign in to ask about your friends.”</extracomment>
        <translation>請登入以詢問朋友的位置。</translation>
    </message>
    <message>
        <source>ANSWER_NOT_SHOWN</source>
        <extracomment>Below a question whose answer is of a kind that cannot be shown. English: “This answer cannot be shown here.”</extracomment>
        <translation>此回答無法在這裡顯示。</translation>
    </message>
    <message>
        <source>ANSWER_RESTRICTED</source>
        <extracomment>Below a question, while the device allows no friends’ locations. English: “Friends’ locations are switched off on this device.”</extracomment>
        <translation>此裝置已關閉朋友位置。</translation>
    </message>
    <message>
        <source>STATUS_UNREADABLE</source>
        <extracomment>Status line: the configuration is broken. English: “Your settings cannot be read.”</extracomment>
        <translation>無法讀取你的設定。</translation>
    </message>
    <message>
        <source>MAP_NOT_AVAILABLE</source>
        <extracomment>In place of a map that nobody can draw. English: “Map not available”</extracomment>
        <translation>無法使用地圖</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_LINK</source>
        <extracomment>What a screen reader would say, written down: %@ can be opened. English: “%@ (link)”</extracomment>
        <translation>%@（連結）</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_IMAGE</source>
        <extracomment>The same: %@ describes a picture. English: “%@ (image)”</extracomment>
        <translation>%@（影像）</translation>
    </message>
    <message>
        <source>ANNOUNCE_QUESTION</source>
        <extracomment>A screen reader’s name for what the user asked. English: “Question”</extracomment>
        <translation>問題</translation>
    </message>
    <message>
        <source>ANNOUNCE_ANSWER</source>
        <extracomment>A screen reader’s name for the sentence that answers. English: “Answer”</extracomment>
        <translation>回答</translation>
    </message>
    <message>
        <source>ANNOUNCE_PEOPLE</source>
        <extracomment>Said after the sentence of an answer that has come: %@ is how many people are on it. English: “People: %@.”</extracomment>
        <translation>人數：%@。</translation>
    </message>
    <message>
        <source>ANNOUNCE_PLACE</source>
        <extracomment>Said when a friend (%1$@) has come to another place (%2$@, such as “Fish Market”, “Home” or “Brinmouth, HB”). English: “%1$@: %2$@.”</extracomment>
        <translation>%1$@：%2$@。</translation>
    </message>
    <message>
        <source>ANNOUNCE_UNSEEN</source>
        <extracomment>Said when the place of a friend (%@) is not told any more. English: “%@ is no longer visible.”</extracomment>
        <translation>已看不到%@的位置。</translation>
    </message>
    <message>
        <source>ANNOUNCE_SEEN</source>
        <extracomment>Said when the place (%2$@) of a friend (%1$@) is known again. English: “%1$@ is visible again: %2$@.”</extracomment>
        <translation>又能看到%1$@的位置：%2$@。</translation>
    </message>
    <message>
        <source>ANNOUNCE_SEEN_SOMEWHERE</source>
        <extracomment>The same for a place without a name. English: “%@ is visible again.”</extracomment>
        <translation>又能看到%@的位置。</translation>
    </message>
    <message>
        <source>ANNOUNCE_UNREACHABLE</source>
        <extracomment>Said when the friends’ service cannot be reached any more. English: “Your friends are out of reach. What is shown may be old.”</extracomment>
        <translation>無法取得朋友的資訊。顯示的內容可能已過時。</translation>
    </message>
    <message>
        <source>ANNOUNCE_REACHABLE</source>
        <extracomment>Said when it can be reached again. English: “Your friends are within reach again.”</extracomment>
        <translation>又能取得朋友的資訊了。</translation>
    </message>
    <message>
        <source>ANNOUNCE_NEXT</source>
        <extracomment>Two sentences that are said one after the other, as the language parts them; each has its full stop. English: “%1$@ %2$@”</extracomment>
        <translation>%1$@%2$@</translation>
    </message>
    <message>
        <source>LINK_NOBODY</source>
        <extracomment>A tap on a link that no program opens</extracomment>
        <translation>這部電腦上沒有能開啟連結的程式。</translation>
    </message>
    <message>
        <source>PLACE_NOBODY</source>
        <extracomment>The same, of a place on the map</extracomment>
        <translation>這部電腦上沒有能開啟地點的程式。</translation>
    </message>
    <message>
        <source>CALL_NOBODY</source>
        <extracomment>The same, of a call</extracomment>
        <translation>這部電腦上沒有能打電話的程式。</translation>
    </message>
    <message>
        <source>WRITE_NOBODY</source>
        <extracomment>The same, of a message</extracomment>
        <translation>這部電腦上沒有能寫訊息的程式。</translation>
    </message>
    <message>
        <source>LINK_REFUSED</source>
        <extracomment>A link of a kind that this program does not open</extracomment>
        <translation>這個連結不在這裡開啟。</translation>
    </message>
    <message>
        <source>LINK_UNKNOWN</source>
        <extracomment>A link from elsewhere about nobody who is among the user’s friends</extracomment>
        <translation>我不知道這個連結說的是誰。</translation>
    </message>
    <message>
        <source>FRIEND_CALL</source>
        <extracomment>Under a round button: calls the friend</extracomment>
        <translation>通話</translation>
    </message>
    <message>
        <source>FRIEND_WRITE</source>
        <extracomment>Under a round button: writes to the friend</extracomment>
        <translation>寫訊息</translation>
    </message>
    <message>
        <source>FRIEND_MAPS</source>
        <extracomment>Under a round button: opens the place in a program for maps</extracomment>
        <translation>在地圖中開啟</translation>
    </message>
    <message>
        <source>FRIEND_COPY</source>
        <extracomment>Under a round button: puts the place into the clipboard</extracomment>
        <translation>拷貝地點</translation>
    </message>
    <message>
        <source>FRIEND_COPIED</source>
        <extracomment>In the place of “Copy place”, for two seconds after it was pressed</extracomment>
        <translation>已拷貝</translation>
    </message>
    <message>
        <source>FRIEND_SHOW</source>
        <extracomment>A button: brings the friend (%@) back into view on the map</extracomment>
        <translation>顯示%@</translation>
    </message>
    <message>
        <source>FRIEND_WHERE</source>
        <extracomment>A button that asks where a friend (%@) is</extracomment>
        <translation>%@在哪裡？</translation>
    </message>
    <message>
        <source>FRIEND_NOT_SEEN</source>
        <extracomment>A friend (%@) whose place is not to be seen</extracomment>
        <translation>我看不到%@在哪裡。</translation>
    </message>
    <message>
        <source>MAP_CLOSER</source>
        <extracomment>A button on the map, spoken: zooms in</extracomment>
        <translation>更近</translation>
    </message>
    <message>
        <source>MAP_FURTHER</source>
        <extracomment>A button on the map, spoken: zooms out</extracomment>
        <translation>更遠</translation>
    </message>
    <message>
        <source>MAP_SPOKEN</source>
        <extracomment>The map of a friend’s page, spoken; %@ is the friend</extracomment>
        <translation>%@周圍的地圖</translation>
    </message>
    <message>
        <source>HOW_FEW</source>
        <extracomment>How exactly a place is known: up to 15 metres</extracomment>
        <translation>幾公尺以內</translation>
    </message>
    <message>
        <source>HOW_WITHIN</source>
        <extracomment>The same; %@ is a distance with its unit</extracomment>
        <translation>大約%@以內</translation>
    </message>
    <message>
        <source>HOW_NEAR</source>
        <extracomment>The same, of a wide place; %@ is a distance with its unit</extracomment>
        <translation>在附近某處，大約%@以內</translation>
    </message>
    <message>
        <source>PAGE_FRIENDS</source>
        <extracomment>The name of the page with the list of friends</extracomment>
        <translation>朋友</translation>
    </message>
    <message>
        <source>PAGE_FRIENDS_NONE</source>
        <extracomment>On that page, when nobody was asked about</extracomment>
        <translation>還沒有問過任何人。</translation>
    </message>
    <message>
        <source>PAGE_ME</source>
        <extracomment>The name of the user’s own page</extracomment>
        <translation>我的位置</translation>
    </message>
    <message>
        <source>SHARING_SWITCH</source>
        <extracomment>A switch on that page</extracomment>
        <translation>朋友可以看到我</translation>
    </message>
    <message>
        <source>SHARING_ON</source>
        <extracomment>Under that switch, while it is on</extracomment>
        <translation>您允許的人可以看到您在哪裡。</translation>
    </message>
    <message>
        <source>SHARING_OFF</source>
        <extracomment>Under that switch, while it is off</extracomment>
        <translation>沒有人能看到您在哪裡。</translation>
    </message>
    <message>
        <source>SHARING_UNKNOWN</source>
        <extracomment>Under that switch, while the service has not been told anything by it</extracomment>
        <translation>您的服務尚未告知。</translation>
    </message>
    <message>
        <source>SHARING_FAILED</source>
        <extracomment>Under that switch, when the wish did not reach the service</extracomment>
        <translation>您的服務沒有回應。這裡沒有任何變化。</translation>
    </message>
    <message>
        <source>MAP_NO_STREETS</source>
        <extracomment>Under a card whose map has no streets</extracomment>
        <translation>這裡還沒有該地區的街道。</translation>
    </message>
    <message>
        <source>MAP_GET_STREETS</source>
        <extracomment>Beside it, a button: chooses a file with a map</extracomment>
        <translation>取得街道</translation>
    </message>
    <message>
        <source>MAP_NO_PLACE</source>
        <extracomment>On the plain ground of a map whose friend has no place</extracomment>
        <translation>沒有位置</translation>
    </message>
    <message>
        <source>MENU_CUT</source>
        <extracomment>In the menu of the field</extracomment>
        <translation>剪下</translation>
    </message>
    <message>
        <source>MENU_COPY</source>
        <extracomment>In the menu of the field and of the conversation</extracomment>
        <translation>拷貝</translation>
    </message>
    <message>
        <source>MENU_PASTE</source>
        <extracomment>In the menu of the field</extracomment>
        <translation>貼上</translation>
    </message>
    <message>
        <source>MENU_SELECT_ALL</source>
        <extracomment>In the menu of the field</extracomment>
        <translation>全選</translation>
    </message>
    <message>
        <source>WATCH_ARRIVAL</source>
        <extracomment>A notification about a friend, below the name: the friend has arrived at %@, a place with a name, or a time such as 17:42. English: “Arrived: %@”</extracomment>
        <translation>已抵達：%@</translation>
    </message>
    <message>
        <source>WATCH_DEPARTURE</source>
        <extracomment>A notification about a friend, below the name: the friend has left %@, a place with a name, or a time such as 17:42. English: “Left: %@”</extracomment>
        <translation>已離開：%@</translation>
    </message>
    <message>
        <source>WATCH_SOMEBODY_ARRIVED</source>
        <extracomment>A notification while the screen is locked: it says neither who nor where. English: “Somebody arrived”</extracomment>
        <translation>有人抵達了</translation>
    </message>
    <message>
        <source>WATCH_SOMEBODY_LEFT</source>
        <extracomment>A notification while the screen is locked: it says neither who nor where. English: “Somebody left”</extracomment>
        <translation>有人離開了</translation>
        <source>PAGE_BACK</source>
        <extracomment>The way back from a page, spoken</extracomment>
        <translation>返回</translation>
    </message>
    <message>
        <source>SETTINGS</source>
        <extracomment>The name of the page with the user’s settings, and spoken of the button that opens it. English: “Settings”</extracomment>
        <translation>設定</translation>
    </message>
    <message>
        <source>SETTINGS_SIGN_OUT</source>
        <extracomment>A button on that page. English: “Sign out”</extracomment>
        <translation>登出</translation>
    </message>
    <message>
        <source>SETTINGS_SHARING</source>
        <extracomment>The name of a section of that page. English: “Sharing”</extracomment>
        <translation>分享</translation>
    </message>
    <message>
        <source>SETTINGS_WHO</source>
        <extracomment>Leads to the service’s own page in a browser. English: “Who sees what”</extracomment>
        <translation>誰能看到什麼</translation>
    </message>
    <message>
        <source>SETTINGS_READING</source>
        <extracomment>The name of a section. English: “Reading”</extracomment>
        <translation>閱讀</translation>
    </message>
    <message>
        <source>SETTINGS_TEXT_SIZE</source>
        <extracomment>A setting; its value is one of the sizes below. English: “Text size”</extracomment>
        <translation>文字大小</translation>
    </message>
    <message>
        <source>SETTINGS_SMALLER</source>
        <extracomment>Spoken: a button beside it. English: “Smaller text”</extracomment>
        <translation>縮小文字</translation>
    </message>
    <message>
        <source>SETTINGS_LARGER</source>
        <extracomment>Spoken: a button beside it. English: “Larger text”</extracomment>
        <translation>放大文字</translation>
    </message>
    <message>
        <source>SIZE_XS</source>
        <extracomment>A text size. English: “Smallest”</extracomment>
        <translation>最小</translation>
    </message>
    <message>
        <source>SIZE_S</source>
        <extracomment>A text size. English: “Smaller”</extracomment>
        <translation>較小</translation>
    </message>
    <message>
        <source>SIZE_M</source>
        <extracomment>A text size. English: “Small”</extracomment>
        <translation>小</translation>
    </message>
    <message>
        <source>SIZE_L</source>
        <extracomment>A text size. English: “Standard”</extracomment>
        <translation>標準</translation>
    </message>
    <message>
        <source>SIZE_XL</source>
        <extracomment>A text size. English: “Large”</extracomment>
        <translation>大</translation>
    </message>
    <message>
        <source>SIZE_XXL</source>
        <extracomment>A text size. English: “Larger”</extracomment>
        <translation>較大</translation>
    </message>
    <message>
        <source>SIZE_XXXL</source>
        <extracomment>A text size. English: “Largest”</extracomment>
        <translation>最大</translation>
    </message>
    <message>
        <source>SIZE_AX</source>
        <extracomment>A text size beyond the largest; %@ is a number from 1 to 5. English: “Very large %@”</extracomment>
        <translation>特大 %@</translation>
    </message>
    <message>
        <source>SETTINGS_COLORS</source>
        <extracomment>A setting; its value is one of the following. English: “Colours”</extracomment>
        <translation>顏色</translation>
    </message>
    <message>
        <source>SETTINGS_AS_SYSTEM</source>
        <extracomment>The value of a setting that follows the desktop. English: “As the system”</extracomment>
        <translation>跟隨系統</translation>
    </message>
    <message>
        <source>COLORS_LIGHT</source>
        <extracomment>Of the colours. English: “Light”</extracomment>
        <translation>淺色</translation>
    </message>
    <message>
        <source>COLORS_DARK</source>
        <extracomment>Of the colours. English: “Dark”</extracomment>
        <translation>深色</translation>
    </message>
    <message>
        <source>COLORS_HIGH</source>
        <extracomment>Of the colours. English: “High contrast”</extracomment>
        <translation>高對比</translation>
    </message>
    <message>
        <source>SETTINGS_DISTANCES</source>
        <extracomment>A setting; its value is one of the following. English: “Distances”</extracomment>
        <translation>距離</translation>
    </message>
    <message>
        <source>DISTANCES_METRIC</source>
        <extracomment>Of the distances. English: “Kilometres”</extracomment>
        <translation>公里</translation>
    </message>
    <message>
        <source>DISTANCES_MILES</source>
        <extracomment>Of the distances. English: “Miles”</extracomment>
        <translation>英里</translation>
    </message>
    <message>
        <source>SETTINGS_LANGUAGE</source>
        <extracomment>A setting; its value is the name of a language. English: “Language”</extracomment>
        <translation>語言</translation>
    </message>
    <message>
        <source>SETTINGS_CONTACTS</source>
        <extracomment>The name of a section: what this computer adds to answers. English: “Contacts and position”</extracomment>
        <translation>聯絡人和位置</translation>
    </message>
    <message>
        <source>SETTINGS_BOOKS</source>
        <extracomment>A switch: the desktop’s address books. English: “Address books”</extracomment>
        <translation>通訊錄</translation>
    </message>
    <message>
        <source>SETTINGS_BOOKS_LINE</source>
        <extracomment>Under that switch. English: “Names and faces come from them.”</extracomment>
        <translation>姓名和頭像來自這裡。</translation>
    </message>
    <message>
        <source>SETTINGS_POSITION</source>
        <extracomment>A switch: where the user’s computer is. English: “My position”</extracomment>
        <translation>我的位置</translation>
    </message>
    <message>
        <source>SETTINGS_POSITION_LINE</source>
        <extracomment>Under that switch. English: “Distances are counted from it.”</extracomment>
        <translation>距離從這裡算起。</translation>
    </message>
    <message>
        <source>SETTINGS_WATCH</source>
        <extracomment>A switch on the page with settings: notifications of friends who come and go</extracomment>
        <translation>通知</translation>
    </message>
    <message>
        <source>SETTINGS_WATCH_LINE</source>
        <extracomment>Under that switch</extracomment>
        <translation>朋友離開或抵達時，依你的要求通知。</translation>
    </message>
    <message>
        <source>SETTINGS_WATCH_NONE</source>
        <extracomment>Under that switch, in the place of its line, where the computer cannot run anything in the background</extracomment>
        <translation>這裡無法在背景執行任何程式。</translation>
    </message>
    <message>
        <source>SETTINGS_MAPS</source>
        <extracomment>The name of a section. English: “Maps”</extracomment>
        <translation>地圖</translation>
    </message>
    <message>
        <source>MAPS_WORLD</source>
        <extracomment>A map that is always there. English: “The world”</extracomment>
        <translation>世界</translation>
    </message>
    <message>
        <source>MAPS_WORLD_LINE</source>
        <extracomment>Under its name. English: “Towns, borders and large roads”</extracomment>
        <translation>城鎮、邊界和主要道路</translation>
    </message>
    <message>
        <source>MAPS_STREETS</source>
        <extracomment>Under the name of a map with streets; %@ is the size of its file, such as “12 MB”. English: “Streets, %@”</extracomment>
        <translation>街道，%@</translation>
    </message>
    <message>
        <source>MAPS_ADD</source>
        <extracomment>Opens a dialog that chooses a file with a map. English: “Add a region”</extracomment>
        <translation>加入地區</translation>
    </message>
    <message>
        <source>MAPS_REMOVE</source>
        <extracomment>A button: the map is not drawn any more. English: “Remove this map”</extracomment>
        <translation>移除此地圖</translation>
    </message>
    <message>
        <source>MAPS_REFUSED</source>
        <extracomment>Said when a chosen file is no map. English: “This file isn’t a map that can be drawn.”</extracomment>
        <translation>此檔案不是可以繪製的地圖。</translation>
    </message>
    <message>
        <source>SETTINGS_HELP</source>
        <extracomment>The name of a section. English: “Help”</extracomment>
        <translation>說明</translation>
    </message>
    <message>
        <source>SETTINGS_SET_FOR_YOU</source>
        <extracomment>Under a setting that an administrator or the command line holds. English: “Set for you”</extracomment>
        <translation>已為你設定</translation>
    </message>
    <message>
        <source>STATUS_TRY_NOW</source>
        <extracomment>A button at the end of the status line while the service cannot be reached. English: “Try now”</extracomment>
        <translation>立即重試</translation>
    </message>
    <message>
        <source>PAGE_FRIENDS_SHARE</source>
        <extracomment>On the page with the list of friends: a section with those who let the user see where they are. English: “They share with you”</extracomment>
        <translation>與你分享的人</translation>
    </message>
    <message>
        <source>SIGN_IN_HAVE_LINK</source>
        <extracomment>A button on the page for signing in: asks for a link instead. English: “I have a link”</extracomment>
        <translation>我有連結</translation>
    </message>
    <message>
        <source>SIGN_IN_USE_SECRET</source>
        <extracomment>A button there: asks for address, person and secret again. English: “Use address and secret”</extracomment>
        <translation>使用位址和密鑰</translation>
    </message>
    <message>
        <source>SIGN_IN_LINK</source>
        <extracomment>Label of a field: a link that signs in. English: “Link”</extracomment>
        <translation>連結</translation>
    </message>
    <message>
        <source>SIGN_IN_LINK_LINE</source>
        <extracomment>Below the title, above that field. English: “Paste the link you were given. It works once.”</extracomment>
        <translation>貼上你收到的連結。它只能使用一次。</translation>
    </message>
    <message>
        <source>SIGN_IN_LINK_SPENT</source>
        <extracomment>Below the link; the service does not tell which of the two it is. English: “This link was used, or is too old. Ask for a new one.”</extracomment>
        <translation>此連結已被使用或已過期。請索取新連結。</translation>
    </message>
    <message>
        <source>SIGN_IN_BAD_LINK</source>
        <extracomment>Below the link. English: “This isn’t a link for signing in.”</extracomment>
        <translation>這不是用於登入的連結。</translation>
    </message>
    <message>
        <source>SIGN_IN_ALREADY</source>
        <extracomment>Said when a link that signs in comes while somebody is signed in. English: “You are signed in. Sign out first to use this link.”</extracomment>
        <translation>你已登入。請先登出再使用此連結。</translation>
    </message>
    <message>
        <source>CHECK_UP</source>
        <extracomment>The name of the page that says what is wrong and what mends it. English: “Check-up”</extracomment>
        <translation>檢查</translation>
    </message>
    <message>
        <source>CHECK_WELL</source>
        <extracomment>Title of that page when nothing is wrong. English: “All is well.”</extracomment>
        <translation>一切正常。</translation>
    </message>
    <message>
        <source>CHECK_NOW</source>
        <extracomment>Below that title. English: “Checked just now.”</extracomment>
        <translation>剛剛檢查過。</translation>
    </message>
    <message>
        <source>CHECK_REST</source>
        <extracomment>Below the title when something is wrong. English: “Everything else is fine. Checked just now.”</extracomment>
        <translation>其他一切正常。剛剛檢查過。</translation>
    </message>
    <message>
        <source>CHECK_HANDS</source>
        <extracomment>Title when something is wrong; %@ is how many things. English: “{0, plural, one{One thing needs a hand.} other{%@ things need a hand.}}”</extracomment>
        <translation>有%@項需要處理。</translation>
    </message>
    <message>
        <source>CHECK_FINE</source>
        <extracomment>The name of the section with what is in order. English: “Fine”</extracomment>
        <translation>正常</translation>
    </message>
    <message>
        <source>CHECK_AGAIN</source>
        <extracomment>A button. English: “Check again”</extracomment>
        <translation>重新檢查</translation>
    </message>
    <message>
        <source>CHECK_REPORT</source>
        <extracomment>A button. English: “Copy report”</extracomment>
        <translation>複製報告</translation>
    </message>
    <message>
        <source>CHECK_COMMAND</source>
        <extracomment>A button: puts the command that mends a thing into the clipboard, for a terminal. English: “Copy the command”</extracomment>
        <translation>複製命令</translation>
    </message>
    <message>
        <source>CHECK_SIGN_IN_AGAIN</source>
        <extracomment>A button. English: “Sign in again”</extracomment>
        <translation>重新登入</translation>
    </message>
    <message>
        <source>CHECK_SET_CLOCK</source>
        <extracomment>A button. English: “Set the clock”</extracomment>
        <translation>校準時鐘</translation>
    </message>
    <message>
        <source>CHECK_ASK_AGAIN</source>
        <extracomment>A button: asks the address book again. English: “Ask it again”</extracomment>
        <translation>再問一次</translation>
    </message>
    <message>
        <source>CHECK_ACCOUNT</source>
        <extracomment>A thing that is fine. English: “Account”</extracomment>
        <translation>帳戶</translation>
    </message>
    <message>
        <source>CHECK_SERVICE</source>
        <extracomment>A thing that is fine. English: “Service”</extracomment>
        <translation>服務</translation>
    </message>
    <message>
        <source>CHECK_CLOCK</source>
        <extracomment>A thing that is fine. English: “Clock”</extracomment>
        <translation>時鐘</translation>
    </message>
    <message>
        <source>CHECK_CONTACTS</source>
        <extracomment>A thing that is fine: files with contacts. English: “Contacts”</extracomment>
        <translation>聯絡人</translation>
    </message>
    <message>
        <source>CHECK_LETTERS</source>
        <extracomment>A thing that is fine: fonts for all scripts. English: “Letters”</extracomment>
        <translation>字型</translation>
    </message>
    <message>
        <source>CHECK_READER</source>
        <extracomment>A thing that is fine. English: “Screen reader”</extracomment>
        <translation>螢幕閱讀器</translation>
    </message>
    <message>
        <source>CHECK_DESKTOP</source>
        <extracomment>A thing that is fine: what the desktop offers to programs. English: “Desktop”</extracomment>
        <translation>桌面</translation>
    </message>
    <message>
        <source>CHECK_NOBODY</source>
        <extracomment>A thing that is wrong. English: “Nobody is signed in.”</extracomment>
        <translation>沒有人登入。</translation>
    </message>
    <message>
        <source>CHECK_LOCKED</source>
        <extracomment>A thing that is wrong. English: “The keyring is locked.”</extracomment>
        <translation>鑰匙圈已鎖定。</translation>
    </message>
    <message>
        <source>CHECK_LOCKED_LINE</source>
        <extracomment>Its cause. English: “Your secret can’t be read, so nobody is asked until it is open.”</extracomment>
        <translation>無法讀取你的密鑰，打開之前不會查詢任何人。</translation>
    </message>
    <message>
        <source>CHECK_UNREACHABLE</source>
        <extracomment>A thing that is wrong. English: “The service can’t be reached.”</extracomment>
        <translation>無法連線到服務。</translation>
    </message>
    <message>
        <source>CHECK_UNREACHABLE_LINE</source>
        <extracomment>Its cause; %@ is an address. English: “Nothing answers at %@.”</extracomment>
        <translation>%@ 沒有回應。</translation>
    </message>
    <message>
        <source>CHECK_REDIRECT_LINE</source>
        <extracomment>Another cause. English: “An address is remembered that isn’t your service’s.”</extracomment>
        <translation>記住了一個不屬於你的服務的位址。</translation>
    </message>
    <message>
        <source>CHECK_UNKNOWN</source>
        <extracomment>A thing that is wrong. English: “The service doesn’t know you any more.”</extracomment>
        <translation>服務不再認得你。</translation>
    </message>
    <message>
        <source>CHECK_CLOCKS</source>
        <extracomment>A thing that is wrong. English: “The clocks disagree.”</extracomment>
        <translation>時鐘不一致。</translation>
    </message>
    <message>
        <source>CHECK_AHEAD</source>
        <extracomment>Its cause; %@ is a number of minutes. English: “This computer is %@ min ahead of the service, so ages are wrong.”</extracomment>
        <translation>此電腦比服務快 %@ 分鐘，因此時間不準確。</translation>
    </message>
    <message>
        <source>CHECK_BEHIND</source>
        <extracomment>Its cause; %@ is a number of minutes. English: “This computer is %@ min behind the service, so ages are wrong.”</extracomment>
        <translation>此電腦比服務慢 %@ 分鐘，因此時間不準確。</translation>
    </message>
    <message>
        <source>CHECK_BOOKS_SILENT</source>
        <extracomment>A thing that is wrong. English: “Your address book is silent.”</extracomment>
        <translation>你的通訊錄沒有回應。</translation>
    </message>
    <message>
        <source>CHECK_BOOKS_LINE</source>
        <extracomment>Its cause. English: “It hasn’t answered. Names come from the service for now.”</extracomment>
        <translation>它沒有回答。姓名暫時來自服務。</translation>
    </message>
    <message>
        <source>CHECK_NO_CONTACTS</source>
        <extracomment>A thing that is wrong. English: “Your contacts can’t be read.”</extracomment>
        <translation>無法讀取你的聯絡人。</translation>
    </message>
    <message>
        <source>CHECK_FILE_LINE</source>
        <extracomment>A cause: of contacts, of a map, of the settings. English: “A file is missing or broken.”</extracomment>
        <translation>有檔案缺失或損壞。</translation>
    </message>
    <message>
        <source>CHECK_NOWHERE</source>
        <extracomment>A thing that is wrong. English: “Nobody knows where you are.”</extracomment>
        <translation>沒有人知道你在哪裡。</translation>
    </message>
    <message>
        <source>CHECK_NOWHERE_LINE</source>
        <extracomment>Its cause. English: “This computer has no position, so there are no distances.”</extracomment>
        <translation>此電腦沒有位置，因此沒有距離。</translation>
    </message>
    <message>
        <source>CHECK_NO_MAP</source>
        <extracomment>A thing that is wrong. English: “A map can’t be drawn.”</extracomment>
        <translation>有地圖無法繪製。</translation>
    </message>
    <message>
        <source>CHECK_NO_LETTERS</source>
        <extracomment>A thing that is wrong. English: “Letters are missing.”</extracomment>
        <translation>缺少字型。</translation>
    </message>
    <message>
        <source>CHECK_LETTERS_LINE</source>
        <extracomment>Its cause. English: “Some names show as boxes.”</extracomment>
        <translation>有些名字顯示為方框。</translation>
    </message>
    <message>
        <source>CHECK_DEAF</source>
        <extracomment>A thing that is wrong. English: “Screen readers can’t listen.”</extracomment>
        <translation>螢幕閱讀器無法收聽。</translation>
    </message>
    <message>
        <source>CHECK_DEAF_LINE</source>
        <extracomment>Its cause. English: “What joins them to programs doesn’t answer.”</extracomment>
        <translation>連接它們與程式的通道沒有回應。</translation>
    </message>
    <message>
        <source>CHECK_NO_DESKTOP</source>
        <extracomment>A thing that is wrong. English: “The desktop doesn’t answer.”</extracomment>
        <translation>桌面沒有回應。</translation>
    </message>
    <message>
        <source>CHECK_NO_DESKTOP_LINE</source>
        <extracomment>Its cause. English: “Its colours and contrast aren’t followed, and links may not open.”</extracomment>
        <translation>無法跟隨其顏色和對比，連結也可能打不開。</translation>
    </message>
    <message>
        <source>SHARING_REFUSED</source>
        <extracomment>Under that switch, when the service does not do this. English: “Your service can’t change this here.”</extracomment>
        <translation>你的服務無法在這裡更改此項。</translation>
    </message>
</context>
</TS>
