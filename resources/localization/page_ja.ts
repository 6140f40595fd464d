<?xml version="1.0" encoding="utf-8"?>
<!DOCTYPE TS>
<TS version="2.1" language="ja" sourcelanguage="en">
<context>
    <name>Localizable</name>
    <message>
        <source>VISIBLE_TO</source>
        <extracomment>Title of the people's page; %@ is the number, in words from NUMBERS or in digits. English: “{0, plural, one{%@ person can see where you are.} other{%@ people can see where you are.}}”</extracomment>
        <translation>{0, plural, other{%@人があなたの居場所を見られます。}}</translation>
    </message>
    <message>
        <source>NUMBERS</source>
        <extracomment>The numbers from one to twelve as they begin VISIBLE_TO, in its gender and case, with a bar between; a hyphen alone where digits are usual. English: “One|Two|Three|Four|Five|Six|Seven|Eight|Nine|Ten|Eleven|Twelve”</extracomment>
        <translation>-</translation>
    </message>
    <message>
        <source>VISIBLE_TO_NOBODY</source>
        <extracomment>Title of the people's page while the reader hides or shares with nobody. English: “Nobody can see where you are.”</extracomment>
        <translation>誰もあなたの居場所を見られません。</translation>
    </message>
    <message>
        <source>VISIBLE</source>
        <extracomment>Label of the one switch over everything. English: “Visible to friends”</extracomment>
        <translation>友だちに公開</translation>
    </message>
    <message>
        <source>VISIBLE_ON</source>
        <extracomment>Below VISIBLE while the switch is on. English: “Off hides you from everyone at once.”</extracomment>
        <translation>オフにすると、すぐに全員から隠れます。</translation>
    </message>
    <message>
        <source>VISIBLE_OFF</source>
        <extracomment>Below VISIBLE while the switch is off. English: “Turn on, and the rules below hold again.”</extracomment>
        <translation>オンにすると、下の決まりがまた有効になります。</translation>
    </message>
    <message>
        <source>SWITCH_ON</source>
        <extracomment>Spoken: a switch, %@ is its label, is on. English: “%@, on”</extracomment>
        <translation>%@、オン</translation>
    </message>
    <message>
        <source>SWITCH_OFF</source>
        <extracomment>Spoken: a switch, %@ is its label, is off. English: “%@, off”</extracomment>
        <translation>%@、オフ</translation>
    </message>
    <message>
        <source>WHO_SEES_ME</source>
        <extracomment>Heading above the list of people who see the reader. English: “Who sees me”</extracomment>
        <translation>私を見られる人</translation>
    </message>
    <message>
        <source>EXACTLY</source>
        <extracomment>How exactly somebody is seen. English: “Exactly”</extracomment>
        <translation>正確な場所</translation>
    </message>
    <message>
        <source>WITHIN_1_KM</source>
        <extracomment>How exactly somebody is seen. English: “Within 1 km”</extracomment>
        <translation>1 km以内</translation>
    </message>
    <message>
        <source>TOWN</source>
        <extracomment>How exactly somebody is seen. English: “The town”</extracomment>
        <translation>町</translation>
    </message>
    <message>
        <source>NAMED_PLACES</source>
        <extracomment>How exactly somebody is seen: only when they are at one of their named places. English: “Only places I have named”</extracomment>
        <translation>名前を付けた場所だけ</translation>
    </message>
    <message>
        <source>RULE_ALWAYS</source>
        <extracomment>A rule: %@ is how exactly. English: “%@, always”</extracomment>
        <translation>%@、ずっと</translation>
    </message>
    <message>
        <source>RULE_MIDNIGHT</source>
        <extracomment>A rule that ends at the next midnight: %@ is how exactly. English: “%@, until midnight”</extracomment>
        <translation>%@、真夜中まで</translation>
    </message>
    <message>
        <source>RULE_TIME</source>
        <extracomment>A rule that ends: %1$@ is how exactly, %2$@ a time or a day and time. English: “%1$@, until %2$@”</extracomment>
        <translation>%1$@、%2$@まで</translation>
    </message>
    <message>
        <source>RULE_PLACE</source>
        <extracomment>A rule that ends when the reader arrives: %1$@ is how exactly, %2$@ the reader's name of a place. English: “%1$@, until you are at %2$@”</extracomment>
        <translation>%1$@、%2$@に着くまで</translation>
    </message>
    <message>
        <source>RULE_ENDED</source>
        <extracomment>In place of a rule that is over: %@ is a day and time. English: “Ended: %@”</extracomment>
        <translation>終了：%@</translation>
    </message>
    <message>
        <source>RULE_ASKED</source>
        <extracomment>A rule without an end asks now and then whether it is still meant; %@ is the day on which it ends without an answer. English: “Still meant? Without an answer it ends: %@.”</extracomment>
        <translation>まだ続けますか？ 返事がなければ終わります：%@。</translation>
    </message>
    <message>
        <source>KEEP_SHARING</source>
        <extracomment>Button: the rule goes on. English: “Keep sharing”</extracomment>
        <translation>共有を続ける</translation>
    </message>
    <message>
        <source>SHARE_WITH</source>
        <extracomment>Row or button that begins a new rule. English: “Share with somebody”</extracomment>
        <translation>誰かと共有</translation>
    </message>
    <message>
        <source>ASKED_TITLE</source>
        <extracomment>Above those who asked the reader to share. English: “Would like to see where you are”</extracomment>
        <translation>あなたの居場所を知りたい人</translation>
    </message>
    <message>
        <source>ASKED_SHARE</source>
        <extracomment>Button beside somebody who asked: leads to the page of a rule. English: “Share”</extracomment>
        <translation>共有する</translation>
    </message>
    <message>
        <source>ASKED_NOT_NOW</source>
        <extracomment>Button beside it: the request goes, nobody hears of it. English: “Not now”</extracomment>
        <translation>今はしない</translation>
    </message>
    <message>
        <source>SHARE_WHO</source>
        <extracomment>Label of a field. English: “Name, e-mail address or phone number”</extracomment>
        <translation>名前、メールアドレスまたは電話番号</translation>
    </message>
    <message>
        <source>SHARE_UNKNOWN</source>
        <extracomment>Nobody was found by what was typed. English: “Nobody here is called so. Whoever runs the service can add people.”</extracomment>
        <translation>その名前の人はいません。サービスを運営する人が追加できます。</translation>
    </message>
    <message>
        <source>SHARE_SELF</source>
        <extracomment>The reader typed their own name. English: “Nobody shares with themselves.”</extracomment>
        <translation>自分とは共有できません。</translation>
    </message>
    <message>
        <source>GO_ON</source>
        <extracomment>Button: to the next step. English: “Go on”</extracomment>
        <translation>次へ</translation>
    </message>
    <message>
        <source>WHO_LOOKED</source>
        <extracomment>Heading above the list of people who looked. English: “Who looked”</extracomment>
        <translation>見た人</translation>
    </message>
    <message>
        <source>ALL_LOOKS</source>
        <extracomment>Row that opens all that is kept of who looked; %@ is a number of days. English: “{0, plural, one{All of the last day} other{All of the last %@ days}}”</extracomment>
        <translation>{0, plural, other{この%@日間のすべて}}</translation>
    </message>
    <message>
        <source>NOBODY_LOOKED</source>
        <extracomment>No entry in the list of people who looked. English: “Nobody has looked.”</extracomment>
        <translation>まだ誰も見ていません。</translation>
    </message>
    <message>
        <source>CARRIED</source>
        <extracomment>After the name of who looked: their phone fetched it by itself, nobody asked. English: “by their phone alone”</extracomment>
        <translation>電話が自動で取得</translation>
    </message>
    <message>
        <source>MY_DATA</source>
        <extracomment>Heading. English: “My phone and my data”</extracomment>
        <translation>電話とデータ</translation>
    </message>
    <message>
        <source>SET_UP_PHONE</source>
        <extracomment>Row and title. English: “Set up a phone”</extracomment>
        <translation>電話を設定</translation>
    </message>
    <message>
        <source>MY_DEVICES</source>
        <extracomment>Row and title: list of phones, programs and browsers. English: “My devices”</extracomment>
        <translation>自分の機器</translation>
    </message>
    <message>
        <source>MY_SETTINGS</source>
        <extracomment>Row and title: language, time zone, how long things are kept. English: “Settings”</extracomment>
        <translation>設定</translation>
    </message>
    <message>
        <source>GET_COPY</source>
        <extracomment>Row: a file with everything about the reader. English: “Get a copy of my data”</extracomment>
        <translation>データの写しを受け取る</translation>
    </message>
    <message>
        <source>DELETE_ALL</source>
        <extracomment>Row and title. English: “Delete everything about me”</extracomment>
        <translation>自分のすべてを消す</translation>
    </message>
    <message>
        <source>SIGN_OUT</source>
        <extracomment>Button. English: “Sign out”</extracomment>
        <translation>サインアウト</translation>
    </message>
    <message>
        <source>BACK</source>
        <extracomment>Spoken: the arrow back. English: “Back”</extracomment>
        <translation>戻る</translation>
    </message>
    <message>
        <source>SEES_TITLE</source>
        <extracomment>Title of the page about one rule; %@ is a name. English: “What %@ sees”</extracomment>
        <translation>%@に見えるもの</translation>
    </message>
    <message>
        <source>SEES_THIS</source>
        <extracomment>Below a row that shows the reader as %@ sees them. English: “%@ sees you exactly like this.”</extracomment>
        <translation>%@にはちょうどこのように見えます。</translation>
    </message>
    <message>
        <source>SEES_NOTHING</source>
        <extracomment>In place of that row; %@ is a name. English: “%@ sees no place of yours now.”</extracomment>
        <translation>%@には今、あなたの場所は見えません。</translation>
    </message>
    <message>
        <source>A_PLACE_WITHIN</source>
        <extracomment>In that row: a place that is known within a distance, %@. English: “Within %@”</extracomment>
        <translation>%@以内</translation>
    </message>
    <message>
        <source>HOW_EXACTLY</source>
        <extracomment>Heading above a choice. English: “How exactly”</extracomment>
        <translation>どのくらい正確に</translation>
    </message>
    <message>
        <source>UNTIL</source>
        <extracomment>Heading above a choice. English: “Until”</extracomment>
        <translation>いつまで</translation>
    </message>
    <message>
        <source>UNTIL_CHANGED</source>
        <extracomment>Choice of when a rule ends: not by itself. English: “I change it”</extracomment>
        <translation>自分で変えるまで</translation>
    </message>
    <message>
        <source>UNTIL_MIDNIGHT</source>
        <extracomment>Choice of when a rule ends. English: “Midnight”</extracomment>
        <translation>真夜中</translation>
    </message>
    <message>
        <source>UNTIL_ARRIVAL</source>
        <extracomment>Choice of when a rule ends; a list of places follows. English: “I arrive at”</extracomment>
        <translation>着くまで：</translation>
    </message>
    <message>
        <source>UNTIL_TIME</source>
        <extracomment>Choice of when a rule ends; a field for a time follows. English: “A time”</extracomment>
        <translation>時刻</translation>
    </message>
    <message>
        <source>SAID_ALOUD</source>
        <extracomment>Label of a box to tick: speakers may say where the reader is. English: “May be said aloud”</extracomment>
        <translation>声に出してよい</translation>
    </message>
    <message>
        <source>SAID_ALOUD_WHERE</source>
        <extracomment>Below SAID_ALOUD; %@ is a name. English: “Speakers at %@’s may say it”</extracomment>
        <translation>%@のスピーカーが読み上げてよい</translation>
    </message>
    <message>
        <source>SAVE</source>
        <extracomment>Button. English: “Save”</extracomment>
        <translation>保存</translation>
    </message>
    <message>
        <source>STOP</source>
        <extracomment>Button and title; %@ is a name. English: “Stop sharing with %@”</extracomment>
        <translation>%@との共有をやめる</translation>
    </message>
    <message>
        <source>STOP_ASK</source>
        <extracomment>Asks before STOP; %@ is a name. English: “%@ will see nothing of you from now on. What their phone has shown stays on it.”</extracomment>
        <translation>%@には今後あなたのことは何も見えません。電話に表示されたものは残ります。</translation>
    </message>
    <message>
        <source>KEEP</source>
        <extracomment>Button: do not stop, do not delete. English: “Keep”</extracomment>
        <translation>そのままにする</translation>
    </message>
    <message>
        <source>STEP_INSTALL</source>
        <extracomment>First step of setting up a phone. English: “Install a tracker app that can send to an address of your own.”</extracomment>
        <translation>自分のアドレスに送れる追跡アプリを入れます。</translation>
    </message>
    <message>
        <source>STEP_TYPE</source>
        <extracomment>Second step; three values follow. English: “Type these three into it.”</extracomment>
        <translation>この三つを入力します。</translation>
    </message>
    <message>
        <source>STEP_RUN</source>
        <extracomment>Third step. English: “Let it run, then look again: the phone’s first place shows up here.”</extracomment>
        <translation>動かしてから、もう一度見てください。電話の最初の場所がここに出ます。</translation>
    </message>
    <message>
        <source>ADDRESS</source>
        <extracomment>Label of a value to type. English: “Address”</extracomment>
        <translation>アドレス</translation>
    </message>
    <message>
        <source>USER</source>
        <extracomment>Label of a value to type. English: “User”</extracomment>
        <translation>ユーザー</translation>
    </message>
    <message>
        <source>PASSWORD</source>
        <extracomment>Label of a value to type. English: “Password”</extracomment>
        <translation>パスワード</translation>
    </message>
    <message>
        <source>SHOWN_ONCE</source>
        <extracomment>Warning below the values. English: “This password is shown once. For another phone, set up another.”</extracomment>
        <translation>このパスワードは一度だけ表示されます。別の電話には別のものを設定してください。</translation>
    </message>
    <message>
        <source>WAS_SHOWN</source>
        <extracomment>In place of the password; %@ is a day. English: “Shown once: %@.”</extracomment>
        <translation>一度表示しました：%@。</translation>
    </message>
    <message>
        <source>ADDRESS_ALONE</source>
        <extracomment>Above an address for apps that take nothing else. English: “For apps that take nothing but an address:”</extracomment>
        <translation>アドレスだけを受け付けるアプリ用：</translation>
    </message>
    <message>
        <source>MAKE_PASSWORD</source>
        <extracomment>Button on the first page of setting up a phone. English: “Show what to type”</extracomment>
        <translation>入力する内容を表示</translation>
    </message>
    <message>
        <source>NOTHING_YET</source>
        <extracomment>No message of a phone has come. English: “Nothing has come yet.”</extracomment>
        <translation>まだ何も届いていません。</translation>
    </message>
    <message>
        <source>HERE_SINCE</source>
        <extracomment>A phone's first place has come; %1$@ is a time, %2$@ a distance. English: “Here since %1$@, within about %2$@.”</extracomment>
        <translation>%1$@から、約%2$@以内。</translation>
    </message>
    <message>
        <source>HERE_SINCE_TIME</source>
        <extracomment>A phone was heard; %@ is a time. English: “Here since %@.”</extracomment>
        <translation>%@から届いています。</translation>
    </message>
    <message>
        <source>LOOK_AGAIN</source>
        <extracomment>Button: loads the page again. English: “Look again”</extracomment>
        <translation>もう一度見る</translation>
    </message>
    <message>
        <source>OTHER_PHONE</source>
        <extracomment>Above a code for a camera. English: “Is the phone another one than this? Point its camera here, and this page opens on it.”</extracomment>
        <translation>設定する電話は別のものですか？ そのカメラをここに向けると、このページが開きます。</translation>
    </message>
    <message>
        <source>CODE</source>
        <extracomment>Spoken: a picture with a code for a camera. English: “Code for a camera”</extracomment>
        <translation>カメラ用のコード</translation>
    </message>
    <message>
        <source>DEVICE_PHONE</source>
        <extracomment>A device of the reader's. English: “Phone”</extracomment>
        <translation>電話</translation>
    </message>
    <message>
        <source>DEVICE_READER</source>
        <extracomment>A device of the reader's: the program that shows friends. English: “Program that asks for friends”</extracomment>
        <translation>友だちの場所を尋ねるプログラム</translation>
    </message>
    <message>
        <source>DEVICE_BROWSER</source>
        <extracomment>A device of the reader's. English: “Browser”</extracomment>
        <translation>ブラウザ</translation>
    </message>
    <message>
        <source>DEVICE_THIS</source>
        <extracomment>A device of the reader's: the one in use. English: “This browser”</extracomment>
        <translation>このブラウザ</translation>
    </message>
    <message>
        <source>DEVICE_HEARD</source>
        <extracomment>Below a device; %@ is a day and time. English: “Last heard: %@”</extracomment>
        <translation>最後の連絡：%@</translation>
    </message>
    <message>
        <source>DEVICE_SINCE</source>
        <extracomment>Below a device; %@ is a day and time. English: “Since: %@”</extracomment>
        <translation>開始：%@</translation>
    </message>
    <message>
        <source>DEVICE_END</source>
        <extracomment>Button: the device may do nothing any more. English: “End”</extracomment>
        <translation>終了</translation>
    </message>
    <message>
        <source>DEVICE_END_SPOKEN</source>
        <extracomment>Spoken: the same button; %@ is the device and its day. English: “End: %@”</extracomment>
        <translation>終了：%@</translation>
    </message>
    <message>
        <source>DEVICE_ASK</source>
        <extracomment>Asks before DEVICE_END. English: “It sends nothing and sees nobody from then on, and what it began ends.”</extracomment>
        <translation>以後は何も送らず、誰も見ません。始めたことも終わります。</translation>
    </message>
    <message>
        <source>SETTINGS_PLACES_KEPT</source>
        <extracomment>Label of a choice of durations. English: “My places are kept for”</extracomment>
        <translation>自分の場所の保存期間</translation>
    </message>
    <message>
        <source>SETTINGS_LOOKS_KEPT</source>
        <extracomment>Label of a choice of durations. English: “Who looked is kept for”</extracomment>
        <translation>見た人の保存期間</translation>
    </message>
    <message>
        <source>SETTINGS_ZONE</source>
        <extracomment>Label of a choice. English: “Time zone”</extracomment>
        <translation>タイムゾーン</translation>
    </message>
    <message>
        <source>SETTINGS_LANGUAGE</source>
        <extracomment>Label of a choice. English: “Language”</extracomment>
        <translation>言語</translation>
    </message>
    <message>
        <source>SAVED</source>
        <extracomment>After saving. English: “Saved.”</extracomment>
        <translation>保存しました。</translation>
    </message>
    <message>
        <source>DELETE_ASK</source>
        <extracomment>Asks before everything about the reader is deleted. English: “Your places, rules, devices and the notes of who looked go for good. Phones of friends keep what they have shown.”</extracomment>
        <translation>場所、決まり、機器、見た人の記録は完全に消えます。友だちの電話に表示されたものは残ります。</translation>
    </message>
    <message>
        <source>DELETE_NOW</source>
        <extracomment>Button. English: “Delete everything”</extracomment>
        <translation>すべて消す</translation>
    </message>
    <message>
        <source>DELETED</source>
        <extracomment>After everything was deleted. English: “Everything about you is deleted.”</extracomment>
        <translation>あなたのすべてを消しました。</translation>
    </message>
    <message>
        <source>LINK_TITLE</source>
        <extracomment>Title of the page that a link opens. English: “Your own page”</extracomment>
        <translation>あなたのページ</translation>
    </message>
    <message>
        <source>LINK_TEXT</source>
        <extracomment>Below it. English: “This link works once. After that this browser stays signed in for 30 days.”</extracomment>
        <translation>このリンクは一度だけ使えます。その後、このブラウザは30日間サインインしたままです。</translation>
    </message>
    <message>
        <source>LINK_OPEN</source>
        <extracomment>Button. English: “Open my page”</extracomment>
        <translation>自分のページを開く</translation>
    </message>
    <message>
        <source>LINK_SPENT</source>
        <extracomment>The link cannot be used any more. English: “This link has been used, or its 15 minutes are over. Ask for another one.”</extracomment>
        <translation>このリンクは使用済みか、15分が過ぎました。新しいものを頼んでください。</translation>
    </message>
    <message>
        <source>SIGNED_OUT</source>
        <extracomment>Title: nobody is signed in. English: “This page opens with a link.”</extracomment>
        <translation>このページはリンクで開きます。</translation>
    </message>
    <message>
        <source>SIGNED_OUT_TEXT</source>
        <extracomment>Below it. English: “Whoever runs the service gives you one. It works once, for 15 minutes.”</extracomment>
        <translation>サービスを運営する人が渡します。15分間、一度だけ使えます。</translation>
    </message>
    <message>
        <source>NO_SUCH_PAGE</source>
        <extracomment>Title. English: “There is no such page.”</extracomment>
        <translation>そのページはありません。</translation>
    </message>
    <message>
        <source>NOT_FROM_HERE</source>
        <extracomment>A form that another page sent. English: “This did not come from your own page. Nothing has changed.”</extracomment>
        <translation>これはあなたのページから来たものではありません。何も変わっていません。</translation>
    </message>
    <message>
        <source>NOT_KEPT</source>
        <extracomment>The service could not write. English: “It could not be kept just now. Nothing has changed; try again in a while.”</extracomment>
        <translation>今は保存できませんでした。何も変わっていません。しばらくしてからもう一度試してください。</translation>
    </message>
    <message>
        <source>NOT_UNDERSTOOD</source>
        <extracomment>A form with something missing. English: “Something is missing there. Nothing has changed; go back and choose again.”</extracomment>
        <translation>足りないものがあります。何も変わっていません。戻って選び直してください。</translation>
    </message>
    <message>
        <source>TIME_WANTED</source>
        <extracomment>No time was given beside the choice of one. English: “Choose the time at which it ends.”</extracomment>
        <translation>終わる時刻を選んでください。</translation>
    </message>
    <message>
        <source>TO_MY_PAGE</source>
        <extracomment>Link. English: “To my page”</extracomment>
        <translation>自分のページへ</translation>
    </message>
    <message>
        <source>MY_PLACES</source>
        <extracomment>Row and title: places to which the reader gave names. English: “My places”</extracomment>
        <translation>自分の場所</translation>
    </message>
    <message>
        <source>PLACE_NONE</source>
        <extracomment>No place has a name. English: “No place has a name yet.”</extracomment>
        <translation>まだ名前の付いた場所はありません。</translation>
    </message>
    <message>
        <source>PLACE_HERE</source>
        <extracomment>Heading and button. English: “Name the place where I am”</extracomment>
        <translation>今いる場所に名前を付ける</translation>
    </message>
    <message>
        <source>PLACE_HERE_HINT</source>
        <extracomment>Below PLACE_HERE. English: “The place of your phone’s last message, and 150 metres around it.”</extracomment>
        <translation>電話の最後の知らせの場所と、その周り150メートル。</translation>
    </message>
    <message>
        <source>PLACE_NO_FIX</source>
        <extracomment>Instead of PLACE_HERE_HINT. English: “Your phone has sent no place yet.”</extracomment>
        <translation>電話はまだ場所を送っていません。</translation>
    </message>
    <message>
        <source>PLACE_NAME</source>
        <extracomment>Label of a field. English: “Name of the place”</extracomment>
        <translation>場所の名前</translation>
    </message>
    <message>
        <source>PLACE_SAID</source>
        <extracomment>Label of a box to tick, and below a place. English: “Friends may hear its name”</extracomment>
        <translation>友だちが名前を聞いてよい</translation>
    </message>
    <message>
        <source>PLACE_UNSAID</source>
        <extracomment>Below a place. English: “Nobody hears its name”</extracomment>
        <translation>誰も名前を聞きません</translation>
    </message>
    <message>
        <source>PLACE_REMOVE</source>
        <extracomment>Button. English: “Remove”</extracomment>
        <translation>取り除く</translation>
    </message>
    <message>
        <source>PLACE_REMOVE_ONE</source>
        <extracomment>Title, and spoken: the same button; %@ is the name of a place. English: “Remove: %@”</extracomment>
        <translation>取り除く：%@</translation>
    </message>
    <message>
        <source>PLACE_REMOVE_ASK</source>
        <extracomment>Asks before PLACE_REMOVE. English: “Its name goes, and rules that were to end there end now.”</extracomment>
        <translation>名前が消え、そこで終わるはずだった決まりは今終わります。</translation>
    </message>
    <message>
        <source>TOLD_MAY</source>
        <extracomment>Label of a switch: whether one person may be told when the reader comes and goes. English: “May be told when you come and go”</extracomment>
        <translation>到着と出発を知らせてよい</translation>
    </message>
    <message>
        <source>TOLD_MAY_HINT</source>
        <extracomment>Below TOLD_MAY; %@ is EXACTLY, a choice on the same page. English: “Holds only with “%@”.”</extracomment>
        <translation>「%@」のときだけ有効です。</translation>
    </message>
    <message>
        <source>TOLD_TITLE</source>
        <extracomment>Title of the page that lists who is told when the reader comes and goes, and the way there. English: “Who is told when I come and go”</extracomment>
        <translation>到着と出発が知らされる人</translation>
    </message>
    <message>
        <source>TOLD_NOBODY</source>
        <extracomment>On the page TOLD_TITLE when the list is empty. English: “Nobody is told.”</extracomment>
        <translation>誰にも知らされません。</translation>
    </message>
    <message>
        <source>TOLD_LEAVING</source>
        <extracomment>In a row with somebody's name: that person is told when the reader leaves %@, a place. English: “When I leave: %@”</extracomment>
        <translation>出発したとき：%@</translation>
    </message>
    <message>
        <source>TOLD_ARRIVING</source>
        <extracomment>In a row with somebody's name: that person is told when the reader arrives at %@, a place. English: “When I arrive: %@”</extracomment>
        <translation>到着したとき：%@</translation>
    </message>
    <message>
        <source>PLACE_CHANGE</source>
        <extracomment>Button beside a place of the reader’s own: opens a page that changes it. English: “Change”</extracomment>
        <translation>変更</translation>
    </message>
    <message>
        <source>PLACE_CHANGE_ONE</source>
        <extracomment>Title of that page, and the spoken name of that button; %@ is the place’s name. English: “Change %@”</extracomment>
        <translation>%@を変更</translation>
    </message>
    <message>
        <source>PLACE_KIND</source>
        <extracomment>Label of a choice: what kind of place it is; below it PLACE_KIND_NONE, PLACE_KIND_HOME and so on. English: “Kind”</extracomment>
        <translation>種類</translation>
    </message>
    <message>
        <source>PLACE_KIND_NONE</source>
        <extracomment>In the choice PLACE_KIND: no kind. English: “None”</extracomment>
        <translation>なし</translation>
    </message>
    <message>
        <source>PLACE_KIND_HOME</source>
        <extracomment>In the choice PLACE_KIND. English: “Home”</extracomment>
        <translation>自宅</translation>
    </message>
    <message>
        <source>PLACE_KIND_WORK</source>
        <extracomment>In the choice PLACE_KIND. English: “Work”</extracomment>
        <translation>職場</translation>
    </message>
    <message>
        <source>PLACE_KIND_SCHOOL</source>
        <extracomment>In the choice PLACE_KIND. English: “School”</extracomment>
        <translation>学校</translation>
    </message>
    <message>
        <source>PLACE_KIND_GYM</source>
        <extracomment>In the choice PLACE_KIND. English: “Gym”</extracomment>
        <translation>ジム</translation>
    </message>
    <message>
        <source>PLACE_KIND_OTHER</source>
        <extracomment>In the choice PLACE_KIND. English: “Other”</extracomment>
        <translation>その他</translation>
    </message>
    <message>
        <source>PLACE_TAKEN</source>
        <extracomment>Complaint when a place is given a name that another one has. English: “Another place of yours has this name.”</extracomment>
        <translation>同じ名前の場所がすでにあります。</translation>
    </message>
    <message>
        <source>NEAR_TOWN</source>
        <extracomment>Where somebody is: %1$@ is the nearest town in the nominative, %2$@ how far away it is (“40 km”). English: “near %1$@, %2$@”</extracomment>
        <translation>%1$@付近、%2$@</translation>
    </message>
    <message>
        <source>STREET_IN_TOWN</source>
        <extracomment>Where somebody is: %1$@ is a street, %2$@ its town; change their order where the language does. English: “%1$@, %2$@”</extracomment>
        <translation>%2$@、%1$@</translation>
    </message>
    <message>
        <source>COORDINATES</source>
        <extracomment>Where somebody is, where nothing has a name: %1$@ is DEGREES_NORTH or DEGREES_SOUTH, %2$@ DEGREES_EAST or DEGREES_WEST. English: “%1$@, %2$@”</extracomment>
        <translation>%1$@、%2$@</translation>
    </message>
    <message>
        <source>DEGREES_NORTH</source>
        <extracomment>A latitude; %@ is a number with two decimals. English: “%@° north”</extracomment>
        <translation>北緯%@°</translation>
    </message>
    <message>
        <source>DEGREES_SOUTH</source>
        <extracomment>A latitude; %@ is a number with two decimals. English: “%@° south”</extracomment>
        <translation>南緯%@°</translation>
    </message>
    <message>
        <source>DEGREES_EAST</source>
        <extracomment>A longitude; %@ is a number with two decimals. English: “%@° east”</extracomment>
        <translation>東経%@°</translation>
    </message>
    <message>
        <source>DEGREES_WEST</source>
        <extracomment>A longitude; %@ is a number with two decimals. English: “%@° west”</extracomment>
        <translation>西経%@°</translation>
    </message>
    <message>
        <source>LINK_COMPUTER</source>
        <extracomment>A button: makes a link with which the program on a computer signs in; and the title of the page that shows it. English: “Sign in on a computer”</extracomment>
        <translation>コンピューターでサインイン</translation>
    </message>
    <message>
        <source>LINK_COMPUTER_TEXT</source>
        <extracomment>Above the link. English: “Paste this link into ktr on the computer. It works once, within 15 minutes.”</extracomment>
        <translation>このリンクをコンピューターの ktr に貼り付けてください。15分以内に一度だけ使えます。</translation>
    </message>
</context>
</TS>
