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
    <message>
        <source>ASK_FIELD</source>
        <extracomment>What stands in the empty field, and its name for a screen reader. English: “Ask about your friends”</extracomment>
        <translation>友だちについて聞く</translation>
    </message>
    <message>
        <source>ASK_SEND</source>
        <extracomment>The button that sends the question. English: “Send”</extracomment>
        <translation>送信</translation>
    </message>
    <message>
        <source>QUESTION_TOO_LONG</source>
        <extracomment>In place of an answer, where what was typed or pasted is too long to be a question</extracomment>
        <translation>質問としては長すぎます。もっと短く尋ねてください。</translation>
    </message>
    <message>
        <source>ASK_STOP</source>
        <extracomment>The same button, while an answer is waited for: it gives the question up. English: “Stop asking”</extracomment>
        <translation>問い合わせを中止</translation>
    </message>
    <message>
        <source>ASKING_SLOW</source>
        <extracomment>In the answer’s place, when it takes more than four seconds. English: “Taking longer than usual…”</extracomment>
        <translation>いつもより時間がかかっています…</translation>
    </message>
    <message>
        <source>STATUS_LIVE_NOW</source>
        <extracomment>Status line: answers keep coming. English: “Live · updated just now”</extracomment>
        <translation>ライブ · たった今更新</translation>
    </message>
    <message>
        <source>STATUS_LIVE_SECONDS</source>
        <extracomment>The same; %@ is a number of seconds. English: “Live · updated %@ s ago”</extracomment>
        <translation>ライブ · %@秒前に更新</translation>
    </message>
    <message>
        <source>STATUS_LIVE_MINUTES</source>
        <extracomment>The same; %@ is a number of minutes. English: “Live · updated %@ min ago”</extracomment>
        <translation>ライブ · %@分前に更新</translation>
    </message>
    <message>
        <source>STATUS_LIVE_HOURS</source>
        <extracomment>The same; %@ is a number of hours. English: “Live · updated %@ h ago”</extracomment>
        <translation>ライブ · %@時間前に更新</translation>
    </message>
    <message>
        <source>STATUS_PAUSED_NOW</source>
        <extracomment>Status line: no more answers come by themselves. English: “Paused · updated just now”</extracomment>
        <translation>一時停止中 · たった今更新</translation>
    </message>
    <message>
        <source>STATUS_PAUSED_SECONDS</source>
        <extracomment>The same; %@ is a number of seconds. English: “Paused · updated %@ s ago”</extracomment>
        <translation>一時停止中 · %@秒前に更新</translation>
    </message>
    <message>
        <source>STATUS_PAUSED_MINUTES</source>
        <extracomment>The same; %@ is a number of minutes. English: “Paused · updated %@ min ago”</extracomment>
        <translation>一時停止中 · %@分前に更新</translation>
    </message>
    <message>
        <source>STATUS_PAUSED_HOURS</source>
        <extracomment>The same; %@ is a number of hours. English: “Paused · updated %@ h ago”</extracomment>
        <translation>一時停止中 · %@時間前に更新</translation>
    </message>
    <message>
        <source>STATUS_FINDING_YOU</source>
        <extracomment>Status line: the user's own position is looked for. English: “Finding where you are…”</extracomment>
        <translation>現在地を探しています…</translation>
    </message>
    <message>
        <source>STATUS_HIDDEN</source>
        <extracomment>The status line while friends cannot see where the user is. English: “Your location is hidden”</extracomment>
        <translation>位置情報は非公開です</translation>
    </message>
    <message>
        <source>STATUS_ASKING</source>
        <extracomment>Status line: a question waits for its answer. English: “Asking…”</extracomment>
        <translation>問い合わせ中…</translation>
    </message>
    <message>
        <source>STATUS_OFFLINE</source>
        <extracomment>Status line: the service cannot be reached, and nothing is on screen. English: “Offline.”</extracomment>
        <translation>オフラインです。</translation>
    </message>
    <message>
        <source>STATUS_OFFLINE_SINCE</source>
        <extracomment>The same with an answer on screen; %@ is the time of day when it was known. English: “Offline. Showing what was known at %@.”</extracomment>
        <translation>オフラインです。%@時点の情報を表示しています。</translation>
    </message>
    <message>
        <source>STATUS_FAULTY</source>
        <extracomment>Status line: the service answers, but with an error, or not in its own words; nothing is on screen. English: “Service error.”</extracomment>
        <translation>サービスのエラーです。</translation>
    </message>
    <message>
        <source>STATUS_FAULTY_SINCE</source>
        <extracomment>The same with an answer on screen; %@ is the time of day when it was known. English: “Service error. Showing what was known at %@.”</extracomment>
        <translation>サービスのエラーです。%@時点の情報を表示しています。</translation>
    </message>
    <message>
        <source>STATUS_UNTRUSTED</source>
        <extracomment>Status line: whoever answers cannot prove to be the service; nothing is on screen. English: “Service not trusted.”</extracomment>
        <translation>サービスを信頼できません。</translation>
    </message>
    <message>
        <source>STATUS_UNTRUSTED_SINCE</source>
        <extracomment>The same with an answer on screen; %@ is the time of day when it was known. English: “Service not trusted. Showing what was known at %@.”</extracomment>
        <translation>サービスを信頼できません。%@時点の情報を表示しています。</translation>
    </message>
    <message>
        <source>STATUS_SIGN_IN</source>
        <extracomment>Status line: the service does not take the account's credentials, or there is no account. English: “Sign in again to see your friends.”</extracomment>
        <translation>友だちを見るには、もう一度サインインしてください。</translation>
    </message>
    <message>
        <source>STATUS_SIGN_IN_FIRST</source>
        <extracomment>Status line: nobody has signed in on this computer yet</extracomment>
        <translation>友達を見るにはサインインしてください。</translation>
    </message>
    <message>
        <source>SIGN_IN_TITLE</source>
        <extracomment>Title of the page for signing in</extracomment>
        <translation>友達はどこにいますか？</translation>
    </message>
    <message>
        <source>SIGN_IN_LINE</source>
        <extracomment>Below that title</extracomment>
        <translation>場所を共有しているサービスにサインインしてください。自分のサービスでもかまいません。</translation>
    </message>
    <message>
        <source>SIGN_IN_ADDRESS</source>
        <extracomment>Label of a field: the address of the service</extracomment>
        <translation>サービスのアドレス</translation>
    </message>
    <message>
        <source>SIGN_IN_YOU</source>
        <extracomment>Label of a field: who signs in</extracomment>
        <translation>あなた</translation>
    </message>
    <message>
        <source>SIGN_IN_SECRET</source>
        <extracomment>Label of a field: the password</extracomment>
        <translation>シークレット</translation>
    </message>
    <message>
        <source>SIGN_IN_GO</source>
        <extracomment>Button: signs in</extracomment>
        <translation>サインイン</translation>
    </message>
    <message>
        <source>SIGN_IN_CHECKING</source>
        <extracomment>On that button while the service is asked</extracomment>
        <translation>確認中…</translation>
    </message>
    <message>
        <source>SIGN_IN_CANCEL</source>
        <extracomment>Button: ends the asking</extracomment>
        <translation>キャンセル</translation>
    </message>
    <message>
        <source>SIGN_IN_RETRY</source>
        <extracomment>Button: asks again after nothing answered</extracomment>
        <translation>もう一度試す</translation>
    </message>
    <message>
        <source>SIGN_IN_SHOW</source>
        <extracomment>Spoken: a button that shows the letters of the secret</extracomment>
        <translation>シークレットを表示</translation>
    </message>
    <message>
        <source>SIGN_IN_HIDE</source>
        <extracomment>Spoken: a button that hides them again</extracomment>
        <translation>シークレットを隠す</translation>
    </message>
    <message>
        <source>SIGN_IN_KEYRING</source>
        <extracomment>Small, below the fields</extracomment>
        <translation>シークレットはこのコンピューターのキーリングに保管されます。</translation>
    </message>
    <message>
        <source>SIGN_IN_UNKNOWN</source>
        <extracomment>Below the secret; does not tell which of the two is wrong</extracomment>
        <translation>この人とこのシークレットの組み合わせをサービスは知りません。両方を確かめるか、新しいシークレットをもらってください。</translation>
    </message>
    <message>
        <source>SIGN_IN_NOTHING_ANSWERS</source>
        <extracomment>Below the address, which is %@</extracomment>
        <translation>%@ から応答がありません。アドレスと、このコンピューターの接続を確かめてください。</translation>
    </message>
    <message>
        <source>SIGN_IN_NOT_TRUSTED</source>
        <extracomment>Below the address, which is %@: its certificate is not valid</extracomment>
        <translation>%@ の応答元があなたのサービスだと確認できないため、何も送信していません。</translation>
    </message>
    <message>
        <source>SIGN_IN_NO_SERVICE</source>
        <extracomment>Below the address, which is %@: it is some other web server</extracomment>
        <translation>%@ では別のものが応答しています。アドレスを確かめてください。</translation>
    </message>
    <message>
        <source>SIGN_IN_FAILING</source>
        <extracomment>Below the address, which is %@: the service reports a failure of its own</extracomment>
        <translation>%@ は今は応じられません。</translation>
    </message>
    <message>
        <source>SIGN_IN_BAD_ADDRESS</source>
        <extracomment>Below the address; keep brin.example as it is</extracomment>
        <translation>サービスのアドレスは brin.example のような形です。</translation>
    </message>
    <message>
        <source>SIGN_IN_LOCKED</source>
        <extracomment>The system's keyring is locked or missing</extracomment>
        <translation>キーリングが閉じています。ロックを解除するか、自分だけが読めるファイルにシークレットを保管してください。</translation>
    </message>
    <message>
        <source>SIGN_IN_UNLOCK</source>
        <extracomment>Button: tries the keyring again</extracomment>
        <translation>キーリングのロックを解除</translation>
    </message>
    <message>
        <source>SIGN_IN_IN_FILE</source>
        <extracomment>Button: keeps the secret in a file instead of the keyring</extracomment>
        <translation>ファイルに保管</translation>
    </message>
    <message>
        <source>SIGN_IN_NOT_WRITTEN</source>
        <extracomment>The configuration cannot be written</extracomment>
        <translation>このコンピューターに設定を保存できません。</translation>
    </message>
    <message>
        <source>GREETING_MORNING</source>
        <extracomment>Title of an empty conversation</extracomment>
        <translation>おはようございます。</translation>
    </message>
    <message>
        <source>GREETING_AFTERNOON</source>
        <extracomment>Title of an empty conversation</extracomment>
        <translation>こんにちは。</translation>
    </message>
    <message>
        <source>GREETING_EVENING</source>
        <extracomment>Title of an empty conversation</extracomment>
        <translation>こんばんは。</translation>
    </message>
    <message>
        <source>GREETING_LINE</source>
        <extracomment>Below that title</extracomment>
        <translation>友達について尋ねるか、質問をタップしてください。</translation>
    </message>
    <message>
        <source>SUGGEST_FRIENDS</source>
        <extracomment>A question that is asked by a tap</extracomment>
        <translation>友達はどこ？</translation>
    </message>
    <message>
        <source>SUGGEST_NEAR</source>
        <extracomment>A question that is asked by a tap</extracomment>
        <translation>近くに誰がいる？</translation>
    </message>
    <message>
        <source>SUGGEST_HIDE</source>
        <extracomment>A wish that is asked for by a tap</extracomment>
        <translation>自分の位置を隠す</translation>
    </message>
    <message>
        <source>ANSWER_UNREACHABLE</source>
        <extracomment>Below a question that nobody answered. English: “Your assistant is out of reach right now.”</extracomment>
        <translation>アシスタントに接続できません。</translation>
    </message>
    <message>
        <source>ANSWER_SIGN_IN</source>
        <extracomment>Below a question that was asked without an account. English: “Sign in to ask about your friends.”</extracomment>
        <translation>友だちについて聞くには、サインインしてください。</translation>
    </message>
    <message>
        <source>ANSWER_NOT_SHOWN</source>
        <extracomment>Below a question whose answer is of a kind that cannot be shown. English: “This answer cannot be shown here.”</extracomment>
        <translation>この回答はここでは表示できません。</translation>
    </message>
    <message>
        <source>ANSWER_RESTRICTED</source>
        <extracomment>Below a question, while the device allows no friends’ locations. English: “Friends’ locations are switched off on this device.”</extracomment>
        <translation>このデバイスでは友だちの位置情報がオフになっています。</translation>
    </message>
    <message>
        <source>STATUS_UNREADABLE</source>
        <extracomment>Status line: the configuration is broken. English: “Your settings cannot be read.”</extracomment>
        <translation>設定を読み込めません。</translation>
    </message>
    <message>
        <source>MAP_NOT_AVAILABLE</source>
        <extracomment>In place of a map that nobody can draw. English: “Map not available”</extracomment>
        <translation>地図を表示できません</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_LINK</source>
        <extracomment>What a screen reader would say, written down: %@ can be opened. English: “%@ (link)”</extracomment>
        <translation>%@（リンク）</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_IMAGE</source>
        <extracomment>The same: %@ describes a picture. English: “%@ (image)”</extracomment>
        <translation>%@（画像）</translation>
    </message>
    <message>
        <source>ANNOUNCE_QUESTION</source>
        <extracomment>A screen reader’s name for what the user asked</extracomment>
        <translation>質問</translation>
    </message>
    <message>
        <source>ANNOUNCE_ANSWER</source>
        <extracomment>A screen reader’s name for the sentence that answers</extracomment>
        <translation>回答</translation>
    </message>
    <message>
        <source>ANNOUNCE_PEOPLE</source>
        <extracomment>Said after the sentence of an answer that has come: %@ is how many people are on it</extracomment>
        <translation>人数：%@。</translation>
    </message>
    <message>
        <source>ANNOUNCE_PLACE</source>
        <extracomment>Said when a friend (%1$@) has come to another place (%2$@, such as “Fish Market”, “Home” or “Brinmouth, HB”)</extracomment>
        <translation>%1$@：%2$@。</translation>
    </message>
    <message>
        <source>ANNOUNCE_UNSEEN</source>
        <extracomment>Said when the place of a friend (%@) is not told any more</extracomment>
        <translation>%@さんの位置情報は表示されなくなりました。</translation>
    </message>
    <message>
        <source>ANNOUNCE_SEEN</source>
        <extracomment>Said when the place (%2$@) of a friend (%1$@) is known again</extracomment>
        <translation>%1$@さんの位置情報が再び表示されました：%2$@。</translation>
    </message>
    <message>
        <source>ANNOUNCE_SEEN_SOMEWHERE</source>
        <extracomment>The same for a place without a name</extracomment>
        <translation>%@さんの位置情報が再び表示されました。</translation>
    </message>
    <message>
        <source>ANNOUNCE_UNREACHABLE</source>
        <extracomment>Said when the friends’ service cannot be reached any more</extracomment>
        <translation>友だちの情報を取得できません。表示は古い可能性があります。</translation>
    </message>
    <message>
        <source>ANNOUNCE_REACHABLE</source>
        <extracomment>Said when it can be reached again</extracomment>
        <translation>友だちの情報を再び取得できるようになりました。</translation>
    </message>
    <message>
        <source>ANNOUNCE_NEXT</source>
        <extracomment>Two sentences that are said one after the other, as the language parts them; each has its full stop</extracomment>
        <translation>%1$@%2$@</translation>
    </message>
    <message>
        <source>LINK_NOBODY</source>
        <extracomment>A tap on a link that no program opens</extracomment>
        <translation>このコンピューターにはリンクを開くプログラムがありません。</translation>
    </message>
    <message>
        <source>PLACE_NOBODY</source>
        <extracomment>The same, of a place on the map</extracomment>
        <translation>このコンピューターには場所を開くプログラムがありません。</translation>
    </message>
    <message>
        <source>CALL_NOBODY</source>
        <extracomment>The same, of a call</extracomment>
        <translation>このコンピューターには電話をかけるプログラムがありません。</translation>
    </message>
    <message>
        <source>WRITE_NOBODY</source>
        <extracomment>The same, of a message</extracomment>
        <translation>このコンピューターにはメッセージを書くプログラムがありません。</translation>
    </message>
    <message>
        <source>LINK_REFUSED</source>
        <extracomment>A link of a kind that this program does not open</extracomment>
        <translation>このリンクはここでは開きません。</translation>
    </message>
    <message>
        <source>LINK_UNKNOWN</source>
        <extracomment>A link from elsewhere about nobody who is among the user’s friends</extracomment>
        <translation>このリンクが誰についてのものか分かりません。</translation>
    </message>
    <message>
        <source>FRIEND_CALL</source>
        <extracomment>Under a round button: calls the friend</extracomment>
        <translation>電話</translation>
    </message>
    <message>
        <source>FRIEND_WRITE</source>
        <extracomment>Under a round button: writes to the friend</extracomment>
        <translation>書く</translation>
    </message>
    <message>
        <source>FRIEND_MAPS</source>
        <extracomment>Under a round button: opens the place in a program for maps</extracomment>
        <translation>地図で開く</translation>
    </message>
    <message>
        <source>FRIEND_COPY</source>
        <extracomment>Under a round button: puts the place into the clipboard</extracomment>
        <translation>場所をコピー</translation>
    </message>
    <message>
        <source>FRIEND_COPIED</source>
        <extracomment>In the place of “Copy place”, for two seconds after it was pressed</extracomment>
        <translation>コピーしました</translation>
    </message>
    <message>
        <source>FRIEND_SHOW</source>
        <extracomment>A button: brings the friend (%@) back into view on the map</extracomment>
        <translation>%@を表示</translation>
    </message>
    <message>
        <source>FRIEND_WHERE</source>
        <extracomment>A button that asks where a friend (%@) is</extracomment>
        <translation>%@はどこ？</translation>
    </message>
    <message>
        <source>FRIEND_NOT_SEEN</source>
        <extracomment>A friend (%@) whose place is not to be seen</extracomment>
        <translation>%@がどこにいるか見えません。</translation>
    </message>
    <message>
        <source>MAP_CLOSER</source>
        <extracomment>A button on the map, spoken: zooms in</extracomment>
        <translation>近づく</translation>
    </message>
    <message>
        <source>MAP_FURTHER</source>
        <extracomment>A button on the map, spoken: zooms out</extracomment>
        <translation>遠ざかる</translation>
    </message>
    <message>
        <source>MAP_SPOKEN</source>
        <extracomment>The map of a friend’s page, spoken; %@ is the friend</extracomment>
        <translation>%@の周りの地図</translation>
    </message>
    <message>
        <source>HOW_FEW</source>
        <extracomment>How exactly a place is known: up to 15 metres</extracomment>
        <translation>数メートル以内</translation>
    </message>
    <message>
        <source>HOW_WITHIN</source>
        <extracomment>The same; %@ is a distance with its unit</extracomment>
        <translation>約%@以内</translation>
    </message>
    <message>
        <source>HOW_NEAR</source>
        <extracomment>The same, of a wide place; %@ is a distance with its unit</extracomment>
        <translation>近くのどこか、約%@以内</translation>
    </message>
    <message>
        <source>PAGE_FRIENDS</source>
        <extracomment>The name of the page with the list of friends</extracomment>
        <translation>友だち</translation>
    </message>
    <message>
        <source>PAGE_FRIENDS_NONE</source>
        <extracomment>On that page, when nobody was asked about</extracomment>
        <translation>まだ誰のことも尋ねていません。</translation>
    </message>
    <message>
        <source>PAGE_ME</source>
        <extracomment>The name of the user’s own page</extracomment>
        <translation>自分の居場所</translation>
    </message>
    <message>
        <source>SHARING_SWITCH</source>
        <extracomment>A switch on that page</extracomment>
        <translation>友だちに居場所を見せる</translation>
    </message>
    <message>
        <source>SHARING_ON</source>
        <extracomment>Under that switch, while it is on</extracomment>
        <translation>許可した人はあなたの居場所を見られます。</translation>
    </message>
    <message>
        <source>SHARING_OFF</source>
        <extracomment>Under that switch, while it is off</extracomment>
        <translation>誰もあなたの居場所を見られません。</translation>
    </message>
    <message>
        <source>SHARING_UNKNOWN</source>
        <extracomment>Under that switch, while the service has not been told anything by it</extracomment>
        <translation>サービスからまだ返事がありません。</translation>
    </message>
    <message>
        <source>SHARING_FAILED</source>
        <extracomment>Under that switch, when the wish did not reach the service</extracomment>
        <translation>サービスから返事がありませんでした。ここでは何も変わっていません。</translation>
    </message>
    <message>
        <source>MAP_NO_STREETS</source>
        <extracomment>Under a card whose map has no streets</extracomment>
        <translation>この地域の道路地図はまだありません。</translation>
    </message>
    <message>
        <source>MAP_GET_STREETS</source>
        <extracomment>Beside it, a button: chooses a file with a map</extracomment>
        <translation>道路地図を追加</translation>
    </message>
    <message>
        <source>MAP_NO_PLACE</source>
        <extracomment>On the plain ground of a map whose friend has no place</extracomment>
        <translation>場所なし</translation>
    </message>
    <message>
        <source>MENU_CUT</source>
        <extracomment>In the menu of the field</extracomment>
        <translation>切り取り</translation>
    </message>
    <message>
        <source>MENU_COPY</source>
        <extracomment>In the menu of the field and of the conversation</extracomment>
        <translation>コピー</translation>
    </message>
    <message>
        <source>MENU_PASTE</source>
        <extracomment>In the menu of the field</extracomment>
        <translation>貼り付け</translation>
    </message>
    <message>
        <source>MENU_SELECT_ALL</source>
        <extracomment>In the menu of the field</extracomment>
        <translation>すべて選択</translation>
    </message>
    <message>
        <source>WATCH_ARRIVAL</source>
        <extracomment>A notification about a friend, below the name: the friend has arrived at %@, a place with a name, or a time such as 17:42. English: “Arrived: %@”</extracomment>
        <translation>到着：%@</translation>
    </message>
    <message>
        <source>WATCH_DEPARTURE</source>
        <extracomment>A notification about a friend, below the name: the friend has left %@, a place with a name, or a time such as 17:42. English: “Left: %@”</extracomment>
        <translation>出発：%@</translation>
    </message>
    <message>
        <source>WATCH_SOMEBODY_ARRIVED</source>
        <extracomment>A notification while the screen is locked: it says neither who nor where. English: “Somebody arrived”</extracomment>
        <translation>誰かが到着しました</translation>
    </message>
    <message>
        <source>WATCH_SOMEBODY_LEFT</source>
        <extracomment>A notification while the screen is locked: it says neither who nor where. English: “Somebody left”</extracomment>
        <translation>誰かが出発しました</translation>
        <source>PAGE_BACK</source>
        <extracomment>The way back from a page, spoken</extracomment>
        <translation>戻る</translation>
    </message>
    <message>
        <source>SETTINGS</source>
        <extracomment>The name of the page with the user’s settings, and spoken of the button that opens it. English: “Settings”</extracomment>
        <translation>設定</translation>
    </message>
    <message>
        <source>SETTINGS_SIGN_OUT</source>
        <extracomment>A button on that page. English: “Sign out”</extracomment>
        <translation>サインアウト</translation>
    </message>
    <message>
        <source>SETTINGS_SHARING</source>
        <extracomment>The name of a section of that page. English: “Sharing”</extracomment>
        <translation>共有</translation>
    </message>
    <message>
        <source>SETTINGS_WHO</source>
        <extracomment>Leads to the service’s own page in a browser. English: “Who sees what”</extracomment>
        <translation>だれに何が見えるか</translation>
    </message>
    <message>
        <source>SETTINGS_READING</source>
        <extracomment>The name of a section. English: “Reading”</extracomment>
        <translation>表示</translation>
    </message>
    <message>
        <source>SETTINGS_TEXT_SIZE</source>
        <extracomment>A setting; its value is one of the sizes below. English: “Text size”</extracomment>
        <translation>文字の大きさ</translation>
    </message>
    <message>
        <source>SETTINGS_SMALLER</source>
        <extracomment>Spoken: a button beside it. English: “Smaller text”</extracomment>
        <translation>文字を小さく</translation>
    </message>
    <message>
        <source>SETTINGS_LARGER</source>
        <extracomment>Spoken: a button beside it. English: “Larger text”</extracomment>
        <translation>文字を大きく</translation>
    </message>
    <message>
        <source>SIZE_XS</source>
        <extracomment>A text size. English: “Smallest”</extracomment>
        <translation>最小</translation>
    </message>
    <message>
        <source>SIZE_S</source>
        <extracomment>A text size. English: “Smaller”</extracomment>
        <translation>より小さい</translation>
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
        <translation>より大きい</translation>
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
        <translation>色</translation>
    </message>
    <message>
        <source>SETTINGS_AS_SYSTEM</source>
        <extracomment>The value of a setting that follows the desktop. English: “As the system”</extracomment>
        <translation>システムと同じ</translation>
    </message>
    <message>
        <source>COLORS_LIGHT</source>
        <extracomment>Of the colours. English: “Light”</extracomment>
        <translation>明るい</translation>
    </message>
    <message>
        <source>COLORS_DARK</source>
        <extracomment>Of the colours. English: “Dark”</extracomment>
        <translation>暗い</translation>
    </message>
    <message>
        <source>COLORS_HIGH</source>
        <extracomment>Of the colours. English: “High contrast”</extracomment>
        <translation>ハイコントラスト</translation>
    </message>
    <message>
        <source>SETTINGS_DISTANCES</source>
        <extracomment>A setting; its value is one of the following. English: “Distances”</extracomment>
        <translation>距離</translation>
    </message>
    <message>
        <source>DISTANCES_METRIC</source>
        <extracomment>Of the distances. English: “Kilometres”</extracomment>
        <translation>キロメートル</translation>
    </message>
    <message>
        <source>DISTANCES_MILES</source>
        <extracomment>Of the distances. English: “Miles”</extracomment>
        <translation>マイル</translation>
    </message>
    <message>
        <source>SETTINGS_LANGUAGE</source>
        <extracomment>A setting; its value is the name of a language. English: “Language”</extracomment>
        <translation>言語</translation>
    </message>
    <message>
        <source>SETTINGS_CONTACTS</source>
        <extracomment>The name of a section: what this computer adds to answers. English: “Contacts and position”</extracomment>
        <translation>連絡先と現在地</translation>
    </message>
    <message>
        <source>SETTINGS_BOOKS</source>
        <extracomment>A switch: the desktop’s address books. English: “Address books”</extracomment>
        <translation>アドレス帳</translation>
    </message>
    <message>
        <source>SETTINGS_BOOKS_LINE</source>
        <extracomment>Under that switch. English: “Names and faces come from them.”</extracomment>
        <translation>名前と顔はここから取ります。</translation>
    </message>
    <message>
        <source>SETTINGS_POSITION</source>
        <extracomment>A switch: where the user’s computer is. English: “My position”</extracomment>
        <translation>自分の現在地</translation>
    </message>
    <message>
        <source>SETTINGS_POSITION_LINE</source>
        <extracomment>Under that switch. English: “Distances are counted from it.”</extracomment>
        <translation>距離はここから測ります。</translation>
    </message>
    <message>
        <source>SETTINGS_WATCH</source>
        <extracomment>A switch on the page with settings: notifications of friends who come and go</extracomment>
        <translation>通知</translation>
    </message>
    <message>
        <source>SETTINGS_WATCH_LINE</source>
        <extracomment>Under that switch</extracomment>
        <translation>友達が出発・到着したときに、頼んだとおり知らせます。</translation>
    </message>
    <message>
        <source>SETTINGS_WATCH_NONE</source>
        <extracomment>Under that switch, in the place of its line, where the computer cannot run anything in the background</extracomment>
        <translation>ここではバックグラウンドで何も動かせません。</translation>
    </message>
    <message>
        <source>SETTINGS_MAPS</source>
        <extracomment>The name of a section. English: “Maps”</extracomment>
        <translation>地図</translation>
    </message>
    <message>
        <source>MAPS_WORLD</source>
        <extracomment>A map that is always there. English: “The world”</extracomment>
        <translation>世界</translation>
    </message>
    <message>
        <source>MAPS_WORLD_LINE</source>
        <extracomment>Under its name. English: “Towns, borders and large roads”</extracomment>
        <translation>町、境界、主な道路</translation>
    </message>
    <message>
        <source>MAPS_STREETS</source>
        <extracomment>Under the name of a map with streets; %@ is the size of its file, such as “12 MB”. English: “Streets, %@”</extracomment>
        <translation>道路、%@</translation>
    </message>
    <message>
        <source>MAPS_ADD</source>
        <extracomment>Opens a dialog that chooses a file with a map. English: “Add a region”</extracomment>
        <translation>地域を追加</translation>
    </message>
    <message>
        <source>MAPS_REMOVE</source>
        <extracomment>A button: the map is not drawn any more. English: “Remove this map”</extracomment>
        <translation>この地図を取り除く</translation>
    </message>
    <message>
        <source>MAPS_REFUSED</source>
        <extracomment>Said when a chosen file is no map. English: “This file isn’t a map that can be drawn.”</extracomment>
        <translation>このファイルは描ける地図ではありません。</translation>
    </message>
    <message>
        <source>SETTINGS_HELP</source>
        <extracomment>The name of a section. English: “Help”</extracomment>
        <translation>ヘルプ</translation>
    </message>
    <message>
        <source>SETTINGS_SET_FOR_YOU</source>
        <extracomment>Under a setting that an administrator or the command line holds. English: “Set for you”</extracomment>
        <translation>管理されています</translation>
    </message>
    <message>
        <source>STATUS_TRY_NOW</source>
        <extracomment>A button at the end of the status line while the service cannot be reached. English: “Try now”</extracomment>
        <translation>今すぐ試す</translation>
    </message>
    <message>
        <source>PAGE_FRIENDS_SHARE</source>
        <extracomment>On the page with the list of friends: a section with those who let the user see where they are. English: “They share with you”</extracomment>
        <translation>あなたと共有している人</translation>
    </message>
    <message>
        <source>SIGN_IN_HAVE_LINK</source>
        <extracomment>A button on the page for signing in: asks for a link instead. English: “I have a link”</extracomment>
        <translation>リンクを持っています</translation>
    </message>
    <message>
        <source>SIGN_IN_USE_SECRET</source>
        <extracomment>A button there: asks for address, person and secret again. English: “Use address and secret”</extracomment>
        <translation>アドレスとシークレットを使う</translation>
    </message>
    <message>
        <source>SIGN_IN_LINK</source>
        <extracomment>Label of a field: a link that signs in. English: “Link”</extracomment>
        <translation>リンク</translation>
    </message>
    <message>
        <source>SIGN_IN_LINK_LINE</source>
        <extracomment>Below the title, above that field. English: “Paste the link you were given. It works once.”</extracomment>
        <translation>もらったリンクを貼り付けてください。一度だけ使えます。</translation>
    </message>
    <message>
        <source>SIGN_IN_LINK_SPENT</source>
        <extracomment>Below the link; the service does not tell which of the two it is. English: “This link was used, or is too old. Ask for a new one.”</extracomment>
        <translation>このリンクは使用済みか、古すぎます。新しいリンクをもらってください。</translation>
    </message>
    <message>
        <source>SIGN_IN_BAD_LINK</source>
        <extracomment>Below the link. English: “This isn’t a link for signing in.”</extracomment>
        <translation>サインイン用のリンクではありません。</translation>
    </message>
    <message>
        <source>SIGN_IN_ALREADY</source>
        <extracomment>Said when a link that signs in comes while somebody is signed in. English: “You are signed in. Sign out first to use this link.”</extracomment>
        <translation>サインイン済みです。このリンクを使うには先にサインアウトしてください。</translation>
    </message>
    <message>
        <source>CHECK_UP</source>
        <extracomment>The name of the page that says what is wrong and what mends it. English: “Check-up”</extracomment>
        <translation>点検</translation>
    </message>
    <message>
        <source>CHECK_WELL</source>
        <extracomment>Title of that page when nothing is wrong. English: “All is well.”</extracomment>
        <translation>問題ありません。</translation>
    </message>
    <message>
        <source>CHECK_NOW</source>
        <extracomment>Below that title. English: “Checked just now.”</extracomment>
        <translation>たった今点検しました。</translation>
    </message>
    <message>
        <source>CHECK_REST</source>
        <extracomment>Below the title when something is wrong. English: “Everything else is fine. Checked just now.”</extracomment>
        <translation>ほかは問題ありません。たった今点検しました。</translation>
    </message>
    <message>
        <source>CHECK_HANDS</source>
        <extracomment>Title when something is wrong; %@ is how many things. English: “{0, plural, one{One thing needs a hand.} other{%@ things need a hand.}}”</extracomment>
        <translation>手当てが必要なことが%@件あります。</translation>
    </message>
    <message>
        <source>CHECK_FINE</source>
        <extracomment>The name of the section with what is in order. English: “Fine”</extracomment>
        <translation>問題なし</translation>
    </message>
    <message>
        <source>CHECK_AGAIN</source>
        <extracomment>A button. English: “Check again”</extracomment>
        <translation>もう一度点検</translation>
    </message>
    <message>
        <source>CHECK_REPORT</source>
        <extracomment>A button. English: “Copy report”</extracomment>
        <translation>報告をコピー</translation>
    </message>
    <message>
        <source>CHECK_COMMAND</source>
        <extracomment>A button: puts the command that mends a thing into the clipboard, for a terminal. English: “Copy the command”</extracomment>
        <translation>コマンドをコピー</translation>
    </message>
    <message>
        <source>CHECK_SIGN_IN_AGAIN</source>
        <extracomment>A button. English: “Sign in again”</extracomment>
        <translation>もう一度サインイン</translation>
    </message>
    <message>
        <source>CHECK_SET_CLOCK</source>
        <extracomment>A button. English: “Set the clock”</extracomment>
        <translation>時計を合わせる</translation>
    </message>
    <message>
        <source>CHECK_ASK_AGAIN</source>
        <extracomment>A button: asks the address book again. English: “Ask it again”</extracomment>
        <translation>もう一度たずねる</translation>
    </message>
    <message>
        <source>CHECK_ACCOUNT</source>
        <extracomment>A thing that is fine. English: “Account”</extracomment>
        <translation>アカウント</translation>
    </message>
    <message>
        <source>CHECK_SERVICE</source>
        <extracomment>A thing that is fine. English: “Service”</extracomment>
        <translation>サービス</translation>
    </message>
    <message>
        <source>CHECK_CLOCK</source>
        <extracomment>A thing that is fine. English: “Clock”</extracomment>
        <translation>時計</translation>
    </message>
    <message>
        <source>CHECK_CONTACTS</source>
        <extracomment>A thing that is fine: files with contacts. English: “Contacts”</extracomment>
        <translation>連絡先</translation>
    </message>
    <message>
        <source>CHECK_LETTERS</source>
        <extracomment>A thing that is fine: fonts for all scripts. English: “Letters”</extracomment>
        <translation>文字</translation>
    </message>
    <message>
        <source>CHECK_READER</source>
        <extracomment>A thing that is fine. English: “Screen reader”</extracomment>
        <translation>スクリーンリーダー</translation>
    </message>
    <message>
        <source>CHECK_DESKTOP</source>
        <extracomment>A thing that is fine: what the desktop offers to programs. English: “Desktop”</extracomment>
        <translation>デスクトップ</translation>
    </message>
    <message>
        <source>CHECK_NOBODY</source>
        <extracomment>A thing that is wrong. English: “Nobody is signed in.”</extracomment>
        <translation>だれもサインインしていません。</translation>
    </message>
    <message>
        <source>CHECK_LOCKED</source>
        <extracomment>A thing that is wrong. English: “The keyring is locked.”</extracomment>
        <translation>キーリングがロックされています。</translation>
    </message>
    <message>
        <source>CHECK_LOCKED_LINE</source>
        <extracomment>Its cause. English: “Your secret can’t be read, so nobody is asked until it is open.”</extracomment>
        <translation>シークレットを読めないため、開くまで問い合わせません。</translation>
    </message>
    <message>
        <source>CHECK_UNREACHABLE</source>
        <extracomment>A thing that is wrong. English: “The service can’t be reached.”</extracomment>
        <translation>サービスにつながりません。</translation>
    </message>
    <message>
        <source>CHECK_UNREACHABLE_LINE</source>
        <extracomment>Its cause; %@ is an address. English: “Nothing answers at %@.”</extracomment>
        <translation>%@ から応答がありません。</translation>
    </message>
    <message>
        <source>CHECK_REDIRECT_LINE</source>
        <extracomment>Another cause. English: “An address is remembered that isn’t your service’s.”</extracomment>
        <translation>サービスのものではないアドレスが記憶されています。</translation>
    </message>
    <message>
        <source>CHECK_UNKNOWN</source>
        <extracomment>A thing that is wrong. English: “The service doesn’t know you any more.”</extracomment>
        <translation>サービスはもうあなたを知りません。</translation>
    </message>
    <message>
        <source>CHECK_CLOCKS</source>
        <extracomment>A thing that is wrong. English: “The clocks disagree.”</extracomment>
        <translation>時計が合っていません。</translation>
    </message>
    <message>
        <source>CHECK_AHEAD</source>
        <extracomment>Its cause; %@ is a number of minutes. English: “This computer is %@ min ahead of the service, so ages are wrong.”</extracomment>
        <translation>このコンピューターはサービスより%@分進んでいるため、経過時間が正しくありません。</translation>
    </message>
    <message>
        <source>CHECK_BEHIND</source>
        <extracomment>Its cause; %@ is a number of minutes. English: “This computer is %@ min behind the service, so ages are wrong.”</extracomment>
        <translation>このコンピューターはサービスより%@分遅れているため、経過時間が正しくありません。</translation>
    </message>
    <message>
        <source>CHECK_BOOKS_SILENT</source>
        <extracomment>A thing that is wrong. English: “Your address book is silent.”</extracomment>
        <translation>アドレス帳が応答しません。</translation>
    </message>
    <message>
        <source>CHECK_BOOKS_LINE</source>
        <extracomment>Its cause. English: “It hasn’t answered. Names come from the service for now.”</extracomment>
        <translation>応答がありません。当面、名前はサービスから取ります。</translation>
    </message>
    <message>
        <source>CHECK_NO_CONTACTS</source>
        <extracomment>A thing that is wrong. English: “Your contacts can’t be read.”</extracomment>
        <translation>連絡先を読めません。</translation>
    </message>
    <message>
        <source>CHECK_FILE_LINE</source>
        <extracomment>A cause: of contacts, of a map, of the settings. English: “A file is missing or broken.”</extracomment>
        <translation>ファイルがないか、壊れています。</translation>
    </message>
    <message>
        <source>CHECK_NOWHERE</source>
        <extracomment>A thing that is wrong. English: “Nobody knows where you are.”</extracomment>
        <translation>あなたの現在地がわかりません。</translation>
    </message>
    <message>
        <source>CHECK_NOWHERE_LINE</source>
        <extracomment>Its cause. English: “This computer has no position, so there are no distances.”</extracomment>
        <translation>このコンピューターには現在地がないため、距離が出ません。</translation>
    </message>
    <message>
        <source>CHECK_NO_MAP</source>
        <extracomment>A thing that is wrong. English: “A map can’t be drawn.”</extracomment>
        <translation>描けない地図があります。</translation>
    </message>
    <message>
        <source>CHECK_NO_LETTERS</source>
        <extracomment>A thing that is wrong. English: “Letters are missing.”</extracomment>
        <translation>足りない文字があります。</translation>
    </message>
    <message>
        <source>CHECK_LETTERS_LINE</source>
        <extracomment>Its cause. English: “Some names show as boxes.”</extracomment>
        <translation>一部の名前が四角になります。</translation>
    </message>
    <message>
        <source>CHECK_DEAF</source>
        <extracomment>A thing that is wrong. English: “Screen readers can’t listen.”</extracomment>
        <translation>スクリーンリーダーが聞き取れません。</translation>
    </message>
    <message>
        <source>CHECK_DEAF_LINE</source>
        <extracomment>Its cause. English: “What joins them to programs doesn’t answer.”</extracomment>
        <translation>プログラムとつなぐ仕組みが応答しません。</translation>
    </message>
    <message>
        <source>CHECK_NO_DESKTOP</source>
        <extracomment>A thing that is wrong. English: “The desktop doesn’t answer.”</extracomment>
        <translation>デスクトップが応答しません。</translation>
    </message>
    <message>
        <source>CHECK_NO_DESKTOP_LINE</source>
        <extracomment>Its cause. English: “Its colours and contrast aren’t followed, and links may not open.”</extracomment>
        <translation>色やコントラストに従えず、リンクが開かないことがあります。</translation>
    </message>
    <message>
        <source>SHARING_REFUSED</source>
        <extracomment>Under that switch, when the service does not do this. English: “Your service can’t change this here.”</extracomment>
        <translation>サービスはここからこれを変えられません。</translation>
    </message>
</context>
</TS>
