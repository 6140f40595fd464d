<?xml version="1.0" encoding="utf-8"?>
<!DOCTYPE TS>
<TS version="2.1" language="zh-Hans" sourcelanguage="en">
<context>
    <name>Localizable</name>
    <message>
        <source>VISIBLE_TO</source>
        <extracomment>Title of the people's page; %@ is the number, in words from NUMBERS or in digits. English: “{0, plural, one{%@ person can see where you are.} other{%@ people can see where you are.}}”</extracomment>
        <translation>{0, plural, other{%@ 个人可以看到你在哪里。}}</translation>
    </message>
    <message>
        <source>NUMBERS</source>
        <extracomment>The numbers from one to twelve as they begin VISIBLE_TO, in its gender and case, with a bar between; a hyphen alone where digits are usual. English: “One|Two|Three|Four|Five|Six|Seven|Eight|Nine|Ten|Eleven|Twelve”</extracomment>
        <translation>-</translation>
    </message>
    <message>
        <source>VISIBLE_TO_NOBODY</source>
        <extracomment>Title of the people's page while the reader hides or shares with nobody. English: “Nobody can see where you are.”</extracomment>
        <translation>没有人可以看到你在哪里。</translation>
    </message>
    <message>
        <source>VISIBLE</source>
        <extracomment>Label of the one switch over everything. English: “Visible to friends”</extracomment>
        <translation>对朋友可见</translation>
    </message>
    <message>
        <source>VISIBLE_ON</source>
        <extracomment>Below VISIBLE while the switch is on. English: “Off hides you from everyone at once.”</extracomment>
        <translation>关闭后立即对所有人隐藏。</translation>
    </message>
    <message>
        <source>VISIBLE_OFF</source>
        <extracomment>Below VISIBLE while the switch is off. English: “Turn on, and the rules below hold again.”</extracomment>
        <translation>打开后，下面的规则重新生效。</translation>
    </message>
    <message>
        <source>SWITCH_ON</source>
        <extracomment>Spoken: a switch, %@ is its label, is on. English: “%@, on”</extracomment>
        <translation>%@，已打开</translation>
    </message>
    <message>
        <source>SWITCH_OFF</source>
        <extracomment>Spoken: a switch, %@ is its label, is off. English: “%@, off”</extracomment>
        <translation>%@，已关闭</translation>
    </message>
    <message>
        <source>WHO_SEES_ME</source>
        <extracomment>Heading above the list of people who see the reader. English: “Who sees me”</extracomment>
        <translation>谁能看到我</translation>
    </message>
    <message>
        <source>EXACTLY</source>
        <extracomment>How exactly somebody is seen. English: “Exactly”</extracomment>
        <translation>精确位置</translation>
    </message>
    <message>
        <source>WITHIN_1_KM</source>
        <extracomment>How exactly somebody is seen. English: “Within 1 km”</extracomment>
        <translation>1 公里以内</translation>
    </message>
    <message>
        <source>TOWN</source>
        <extracomment>How exactly somebody is seen. English: “The town”</extracomment>
        <translation>所在城镇</translation>
    </message>
    <message>
        <source>NAMED_PLACES</source>
        <extracomment>How exactly somebody is seen: only when they are at one of their named places. English: “Only places I have named”</extracomment>
        <translation>仅限我命名的地点</translation>
    </message>
    <message>
        <source>RULE_ALWAYS</source>
        <extracomment>A rule: %@ is how exactly. English: “%@, always”</extracomment>
        <translation>%@，一直</translation>
    </message>
    <message>
        <source>RULE_MIDNIGHT</source>
        <extracomment>A rule that ends at the next midnight: %@ is how exactly. English: “%@, until midnight”</extracomment>
        <translation>%@，到午夜为止</translation>
    </message>
    <message>
        <source>RULE_TIME</source>
        <extracomment>A rule that ends: %1$@ is how exactly, %2$@ a time or a day and time. English: “%1$@, until %2$@”</extracomment>
        <translation>%1$@，到%2$@为止</translation>
    </message>
    <message>
        <source>RULE_PLACE</source>
        <extracomment>A rule that ends when the reader arrives: %1$@ is how exactly, %2$@ the reader's name of a place. English: “%1$@, until you are at %2$@”</extracomment>
        <translation>%1$@，到达%2$@为止</translation>
    </message>
    <message>
        <source>RULE_ENDED</source>
        <extracomment>In place of a rule that is over: %@ is a day and time. English: “Ended: %@”</extracomment>
        <translation>已结束：%@</translation>
    </message>
    <message>
        <source>RULE_ASKED</source>
        <extracomment>A rule without an end asks now and then whether it is still meant; %@ is the day on which it ends without an answer. English: “Still meant? Without an answer it ends: %@.”</extracomment>
        <translation>还要继续吗？不回答就会结束：%@。</translation>
    </message>
    <message>
        <source>KEEP_SHARING</source>
        <extracomment>Button: the rule goes on. English: “Keep sharing”</extracomment>
        <translation>继续共享</translation>
    </message>
    <message>
        <source>SHARE_WITH</source>
        <extracomment>Row or button that begins a new rule. English: “Share with somebody”</extracomment>
        <translation>与某人共享</translation>
    </message>
    <message>
        <source>ASKED_TITLE</source>
        <extracomment>Above those who asked the reader to share. English: “Would like to see where you are”</extracomment>
        <translation>想看到你在哪里的人</translation>
    </message>
    <message>
        <source>ASKED_SHARE</source>
        <extracomment>Button beside somebody who asked: leads to the page of a rule. English: “Share”</extracomment>
        <translation>共享</translation>
    </message>
    <message>
        <source>ASKED_NOT_NOW</source>
        <extracomment>Button beside it: the request goes, nobody hears of it. English: “Not now”</extracomment>
        <translation>暂不</translation>
    </message>
    <message>
        <source>SHARE_WHO</source>
        <extracomment>Label of a field. English: “Name, e-mail address or phone number”</extracomment>
        <translation>姓名、电子邮件地址或电话号码</translation>
    </message>
    <message>
        <source>SHARE_UNKNOWN</source>
        <extracomment>Nobody was found by what was typed. English: “Nobody here is called so. Whoever runs the service can add people.”</extracomment>
        <translation>这里没有叫这个名字的人。服务的管理者可以添加。</translation>
    </message>
    <message>
        <source>SHARE_SELF</source>
        <extracomment>The reader typed their own name. English: “Nobody shares with themselves.”</extracomment>
        <translation>不能与自己共享。</translation>
    </message>
    <message>
        <source>GO_ON</source>
        <extracomment>Button: to the next step. English: “Go on”</extracomment>
        <translation>继续</translation>
    </message>
    <message>
        <source>WHO_LOOKED</source>
        <extracomment>Heading above the list of people who looked. English: “Who looked”</extracomment>
        <translation>谁看过</translation>
    </message>
    <message>
        <source>ALL_LOOKS</source>
        <extracomment>Row that opens all that is kept of who looked; %@ is a number of days. English: “{0, plural, one{All of the last day} other{All of the last %@ days}}”</extracomment>
        <translation>{0, plural, other{最近 %@ 天的全部}}</translation>
    </message>
    <message>
        <source>NOBODY_LOOKED</source>
        <extracomment>No entry in the list of people who looked. English: “Nobody has looked.”</extracomment>
        <translation>没有人看过。</translation>
    </message>
    <message>
        <source>CARRIED</source>
        <extracomment>After the name of who looked: their phone fetched it by itself, nobody asked. English: “by their phone alone”</extracomment>
        <translation>仅由手机自动获取</translation>
    </message>
    <message>
        <source>MY_DATA</source>
        <extracomment>Heading. English: “My phone and my data”</extracomment>
        <translation>我的手机和数据</translation>
    </message>
    <message>
        <source>SET_UP_PHONE</source>
        <extracomment>Row and title. English: “Set up a phone”</extracomment>
        <translation>设置手机</translation>
    </message>
    <message>
        <source>MY_DEVICES</source>
        <extracomment>Row and title: list of phones, programs and browsers. English: “My devices”</extracomment>
        <translation>我的设备</translation>
    </message>
    <message>
        <source>MY_SETTINGS</source>
        <extracomment>Row and title: language, time zone, how long things are kept. English: “Settings”</extracomment>
        <translation>设置</translation>
    </message>
    <message>
        <source>GET_COPY</source>
        <extracomment>Row: a file with everything about the reader. English: “Get a copy of my data”</extracomment>
        <translation>获取我的数据副本</translation>
    </message>
    <message>
        <source>DELETE_ALL</source>
        <extracomment>Row and title. English: “Delete everything about me”</extracomment>
        <translation>删除我的一切</translation>
    </message>
    <message>
        <source>SIGN_OUT</source>
        <extracomment>Button. English: “Sign out”</extracomment>
        <translation>退出登录</translation>
    </message>
    <message>
        <source>BACK</source>
        <extracomment>Spoken: the arrow back. English: “Back”</extracomment>
        <translation>返回</translation>
    </message>
    <message>
        <source>SEES_TITLE</source>
        <extracomment>Title of the page about one rule; %@ is a name. English: “What %@ sees”</extracomment>
        <translation>%@能看到什么</translation>
    </message>
    <message>
        <source>SEES_THIS</source>
        <extracomment>Below a row that shows the reader as %@ sees them. English: “%@ sees you exactly like this.”</extracomment>
        <translation>%@看到的你就是这样。</translation>
    </message>
    <message>
        <source>SEES_NOTHING</source>
        <extracomment>In place of that row; %@ is a name. English: “%@ sees no place of yours now.”</extracomment>
        <translation>%@现在看不到你的任何位置。</translation>
    </message>
    <message>
        <source>A_PLACE_WITHIN</source>
        <extracomment>In that row: a place that is known within a distance, %@. English: “Within %@”</extracomment>
        <translation>%@以内</translation>
    </message>
    <message>
        <source>HOW_EXACTLY</source>
        <extracomment>Heading above a choice. English: “How exactly”</extracomment>
        <translation>精确程度</translation>
    </message>
    <message>
        <source>UNTIL</source>
        <extracomment>Heading above a choice. English: “Until”</extracomment>
        <translation>直到</translation>
    </message>
    <message>
        <source>UNTIL_CHANGED</source>
        <extracomment>Choice of when a rule ends: not by itself. English: “I change it”</extracomment>
        <translation>我自己更改</translation>
    </message>
    <message>
        <source>UNTIL_MIDNIGHT</source>
        <extracomment>Choice of when a rule ends. English: “Midnight”</extracomment>
        <translation>午夜</translation>
    </message>
    <message>
        <source>UNTIL_ARRIVAL</source>
        <extracomment>Choice of when a rule ends; a list of places follows. English: “I arrive at”</extracomment>
        <translation>我到达</translation>
    </message>
    <message>
        <source>UNTIL_TIME</source>
        <extracomment>Choice of when a rule ends; a field for a time follows. English: “A time”</extracomment>
        <translation>某个时间</translation>
    </message>
    <message>
        <source>SAID_ALOUD</source>
        <extracomment>Label of a box to tick: speakers may say where the reader is. English: “May be said aloud”</extracomment>
        <translation>可以朗读出来</translation>
    </message>
    <message>
        <source>SAID_ALOUD_WHERE</source>
        <extracomment>Below SAID_ALOUD; %@ is a name. English: “Speakers at %@’s may say it”</extracomment>
        <translation>%@那里的音箱可以说出来</translation>
    </message>
    <message>
        <source>SAVE</source>
        <extracomment>Button. English: “Save”</extracomment>
        <translation>保存</translation>
    </message>
    <message>
        <source>STOP</source>
        <extracomment>Button and title; %@ is a name. English: “Stop sharing with %@”</extracomment>
        <translation>停止与%@共享</translation>
    </message>
    <message>
        <source>STOP_ASK</source>
        <extracomment>Asks before STOP; %@ is a name. English: “%@ will see nothing of you from now on. What their phone has shown stays on it.”</extracomment>
        <translation>从现在起%@看不到你的任何信息。手机上显示过的内容会留在那里。</translation>
    </message>
    <message>
        <source>KEEP</source>
        <extracomment>Button: do not stop, do not delete. English: “Keep”</extracomment>
        <translation>保留</translation>
    </message>
    <message>
        <source>STEP_INSTALL</source>
        <extracomment>First step of setting up a phone. English: “Install a tracker app that can send to an address of your own.”</extracomment>
        <translation>安装一个可以向自定义地址发送的追踪应用。</translation>
    </message>
    <message>
        <source>STEP_TYPE</source>
        <extracomment>Second step; three values follow. English: “Type these three into it.”</extracomment>
        <translation>把这三项输入进去。</translation>
    </message>
    <message>
        <source>STEP_RUN</source>
        <extracomment>Third step. English: “Let it run, then look again: the phone’s first place shows up here.”</extracomment>
        <translation>让它运行，然后再看一次：手机的第一个位置会显示在这里。</translation>
    </message>
    <message>
        <source>ADDRESS</source>
        <extracomment>Label of a value to type. English: “Address”</extracomment>
        <translation>地址</translation>
    </message>
    <message>
        <source>USER</source>
        <extracomment>Label of a value to type. English: “User”</extracomment>
        <translation>用户</translation>
    </message>
    <message>
        <source>PASSWORD</source>
        <extracomment>Label of a value to type. English: “Password”</extracomment>
        <translation>密码</translation>
    </message>
    <message>
        <source>SHOWN_ONCE</source>
        <extracomment>Warning below the values. English: “This password is shown once. For another phone, set up another.”</extracomment>
        <translation>此密码只显示一次。另一部手机请另行设置。</translation>
    </message>
    <message>
        <source>WAS_SHOWN</source>
        <extracomment>In place of the password; %@ is a day. English: “Shown once: %@.”</extracomment>
        <translation>已显示一次：%@。</translation>
    </message>
    <message>
        <source>ADDRESS_ALONE</source>
        <extracomment>Above an address for apps that take nothing else. English: “For apps that take nothing but an address:”</extracomment>
        <translation>适用于只接受地址的应用：</translation>
    </message>
    <message>
        <source>MAKE_PASSWORD</source>
        <extracomment>Button on the first page of setting up a phone. English: “Show what to type”</extracomment>
        <translation>显示要输入的内容</translation>
    </message>
    <message>
        <source>NOTHING_YET</source>
        <extracomment>No message of a phone has come. English: “Nothing has come yet.”</extracomment>
        <translation>还没有收到任何内容。</translation>
    </message>
    <message>
        <source>HERE_SINCE</source>
        <extracomment>A phone's first place has come; %1$@ is a time, %2$@ a distance. English: “Here since %1$@, within about %2$@.”</extracomment>
        <translation>自%1$@起在此，误差约%2$@。</translation>
    </message>
    <message>
        <source>HERE_SINCE_TIME</source>
        <extracomment>A phone was heard; %@ is a time. English: “Here since %@.”</extracomment>
        <translation>自%@起在此。</translation>
    </message>
    <message>
        <source>LOOK_AGAIN</source>
        <extracomment>Button: loads the page again. English: “Look again”</extracomment>
        <translation>再看一次</translation>
    </message>
    <message>
        <source>OTHER_PHONE</source>
        <extracomment>Above a code for a camera. English: “Is the phone another one than this? Point its camera here, and this page opens on it.”</extracomment>
        <translation>要用的是另一部手机吗？用它的相机对准这里，此页面就会在上面打开。</translation>
    </message>
    <message>
        <source>CODE</source>
        <extracomment>Spoken: a picture with a code for a camera. English: “Code for a camera”</extracomment>
        <translation>供相机扫描的二维码</translation>
    </message>
    <message>
        <source>DEVICE_PHONE</source>
        <extracomment>A device of the reader's. English: “Phone”</extracomment>
        <translation>手机</translation>
    </message>
    <message>
        <source>DEVICE_READER</source>
        <extracomment>A device of the reader's: the program that shows friends. English: “Program that asks for friends”</extracomment>
        <translation>查询朋友的程序</translation>
    </message>
    <message>
        <source>DEVICE_BROWSER</source>
        <extracomment>A device of the reader's. English: “Browser”</extracomment>
        <translation>浏览器</translation>
    </message>
    <message>
        <source>DEVICE_THIS</source>
        <extracomment>A device of the reader's: the one in use. English: “This browser”</extracomment>
        <translation>此浏览器</translation>
    </message>
    <message>
        <source>DEVICE_HEARD</source>
        <extracomment>Below a device; %@ is a day and time. English: “Last heard: %@”</extracomment>
        <translation>上次收到：%@</translation>
    </message>
    <message>
        <source>DEVICE_SINCE</source>
        <extracomment>Below a device; %@ is a day and time. English: “Since: %@”</extracomment>
        <translation>开始于：%@</translation>
    </message>
    <message>
        <source>DEVICE_END</source>
        <extracomment>Button: the device may do nothing any more. English: “End”</extracomment>
        <translation>结束</translation>
    </message>
    <message>
        <source>DEVICE_END_SPOKEN</source>
        <extracomment>Spoken: the same button; %@ is the device and its day. English: “End: %@”</extracomment>
        <translation>结束：%@</translation>
    </message>
    <message>
        <source>DEVICE_ASK</source>
        <extracomment>Asks before DEVICE_END. English: “It sends nothing and sees nobody from then on, and what it began ends.”</extracomment>
        <translation>此后它不再发送任何内容，也看不到任何人，它开始的一切也会结束。</translation>
    </message>
    <message>
        <source>SETTINGS_PLACES_KEPT</source>
        <extracomment>Label of a choice of durations. English: “My places are kept for”</extracomment>
        <translation>我的位置保留</translation>
    </message>
    <message>
        <source>SETTINGS_LOOKS_KEPT</source>
        <extracomment>Label of a choice of durations. English: “Who looked is kept for”</extracomment>
        <translation>查看记录保留</translation>
    </message>
    <message>
        <source>SETTINGS_ZONE</source>
        <extracomment>Label of a choice. English: “Time zone”</extracomment>
        <translation>时区</translation>
    </message>
    <message>
        <source>SETTINGS_LANGUAGE</source>
        <extracomment>Label of a choice. English: “Language”</extracomment>
        <translation>语言</translation>
    </message>
    <message>
        <source>SAVED</source>
        <extracomment>After saving. English: “Saved.”</extracomment>
        <translation>已保存。</translation>
    </message>
    <message>
        <source>DELETE_ASK</source>
        <extracomment>Asks before everything about the reader is deleted. English: “Your places, rules, devices and the notes of who looked go for good. Phones of friends keep what they have shown.”</extracomment>
        <translation>你的位置、规则、设备和查看记录将永久消失。朋友的手机会保留已显示的内容。</translation>
    </message>
    <message>
        <source>DELETE_NOW</source>
        <extracomment>Button. English: “Delete everything”</extracomment>
        <translation>全部删除</translation>
    </message>
    <message>
        <source>DELETED</source>
        <extracomment>After everything was deleted. English: “Everything about you is deleted.”</extracomment>
        <translation>你的一切都已删除。</translation>
    </message>
    <message>
        <source>LINK_TITLE</source>
        <extracomment>Title of the page that a link opens. English: “Your own page”</extracomment>
        <translation>你自己的页面</translation>
    </message>
    <message>
        <source>LINK_TEXT</source>
        <extracomment>Below it. English: “This link works once. After that this browser stays signed in for 30 days.”</extracomment>
        <translation>此链接只能使用一次。之后此浏览器保持登录 30 天。</translation>
    </message>
    <message>
        <source>LINK_OPEN</source>
        <extracomment>Button. English: “Open my page”</extracomment>
        <translation>打开我的页面</translation>
    </message>
    <message>
        <source>LINK_SPENT</source>
        <extracomment>The link cannot be used any more. English: “This link has been used, or its 15 minutes are over. Ask for another one.”</extracomment>
        <translation>此链接已被使用，或 15 分钟已过。请再要一个。</translation>
    </message>
    <message>
        <source>SIGNED_OUT</source>
        <extracomment>Title: nobody is signed in. English: “This page opens with a link.”</extracomment>
        <translation>此页面通过链接打开。</translation>
    </message>
    <message>
        <source>SIGNED_OUT_TEXT</source>
        <extracomment>Below it. English: “Whoever runs the service gives you one. It works once, for 15 minutes.”</extracomment>
        <translation>服务的管理者会给你一个。它在 15 分钟内有效，只能用一次。</translation>
    </message>
    <message>
        <source>NO_SUCH_PAGE</source>
        <extracomment>Title. English: “There is no such page.”</extracomment>
        <translation>没有这个页面。</translation>
    </message>
    <message>
        <source>NOT_FROM_HERE</source>
        <extracomment>A form that another page sent. English: “This did not come from your own page. Nothing has changed.”</extracomment>
        <translation>这不是来自你自己的页面。没有任何更改。</translation>
    </message>
    <message>
        <source>NOT_KEPT</source>
        <extracomment>The service could not write. English: “It could not be kept just now. Nothing has changed; try again in a while.”</extracomment>
        <translation>现在无法保存。没有任何更改；请稍后再试。</translation>
    </message>
    <message>
        <source>NOT_UNDERSTOOD</source>
        <extracomment>A form with something missing. English: “Something is missing there. Nothing has changed; go back and choose again.”</extracomment>
        <translation>缺少一些内容。没有任何更改；请返回重新选择。</translation>
    </message>
    <message>
        <source>TIME_WANTED</source>
        <extracomment>No time was given beside the choice of one. English: “Choose the time at which it ends.”</extracomment>
        <translation>请选择结束的时间。</translation>
    </message>
    <message>
        <source>TO_MY_PAGE</source>
        <extracomment>Link. English: “To my page”</extracomment>
        <translation>前往我的页面</translation>
    </message>
    <message>
        <source>MY_PLACES</source>
        <extracomment>Row and title: places to which the reader gave names. English: “My places”</extracomment>
        <translation>我的地点</translation>
    </message>
    <message>
        <source>PLACE_NONE</source>
        <extracomment>No place has a name. English: “No place has a name yet.”</extracomment>
        <translation>还没有命名的地点。</translation>
    </message>
    <message>
        <source>PLACE_HERE</source>
        <extracomment>Heading and button. English: “Name the place where I am”</extracomment>
        <translation>为我所在的地点命名</translation>
    </message>
    <message>
        <source>PLACE_HERE_HINT</source>
        <extracomment>Below PLACE_HERE. English: “The place of your phone’s last message, and 150 metres around it.”</extracomment>
        <translation>你的手机最后一条消息的位置，以及周围 150 米。</translation>
    </message>
    <message>
        <source>PLACE_NO_FIX</source>
        <extracomment>Instead of PLACE_HERE_HINT. English: “Your phone has sent no place yet.”</extracomment>
        <translation>你的手机还没有发送位置。</translation>
    </message>
    <message>
        <source>PLACE_NAME</source>
        <extracomment>Label of a field. English: “Name of the place”</extracomment>
        <translation>地点名称</translation>
    </message>
    <message>
        <source>PLACE_SAID</source>
        <extracomment>Label of a box to tick, and below a place. English: “Friends may hear its name”</extracomment>
        <translation>朋友可以听到名称</translation>
    </message>
    <message>
        <source>PLACE_UNSAID</source>
        <extracomment>Below a place. English: “Nobody hears its name”</extracomment>
        <translation>没有人能听到名称</translation>
    </message>
    <message>
        <source>PLACE_REMOVE</source>
        <extracomment>Button. English: “Remove”</extracomment>
        <translation>移除</translation>
    </message>
    <message>
        <source>PLACE_REMOVE_ONE</source>
        <extracomment>Title, and spoken: the same button; %@ is the name of a place. English: “Remove: %@”</extracomment>
        <translation>移除：%@</translation>
    </message>
    <message>
        <source>PLACE_REMOVE_ASK</source>
        <extracomment>Asks before PLACE_REMOVE. English: “Its name goes, and rules that were to end there end now.”</extracomment>
        <translation>名称会消失，原本在那里结束的规则现在结束。</translation>
    </message>
    <message>
        <source>TOLD_MAY</source>
        <extracomment>Label of a switch: whether one person may be told when the reader comes and goes. English: “May be told when you come and go”</extracomment>
        <translation>可以得知你的到达和离开</translation>
    </message>
    <message>
        <source>TOLD_MAY_HINT</source>
        <extracomment>Below TOLD_MAY; %@ is EXACTLY, a choice on the same page. English: “Holds only with “%@”.”</extracomment>
        <translation>仅在“%@”时有效。</translation>
    </message>
    <message>
        <source>TOLD_TITLE</source>
        <extracomment>Title of the page that lists who is told when the reader comes and goes, and the way there. English: “Who is told when I come and go”</extracomment>
        <translation>谁会得知我的到达和离开</translation>
    </message>
    <message>
        <source>TOLD_NOBODY</source>
        <extracomment>On the page TOLD_TITLE when the list is empty. English: “Nobody is told.”</extracomment>
        <translation>没有人会得知。</translation>
    </message>
    <message>
        <source>TOLD_LEAVING</source>
        <extracomment>In a row with somebody's name: that person is told when the reader leaves %@, a place. English: “When I leave: %@”</extracomment>
        <translation>离开时：%@</translation>
    </message>
    <message>
        <source>TOLD_ARRIVING</source>
        <extracomment>In a row with somebody's name: that person is told when the reader arrives at %@, a place. English: “When I arrive: %@”</extracomment>
        <translation>到达时：%@</translation>
    </message>
    <message>
        <source>PLACE_CHANGE</source>
        <extracomment>Button beside a place of the reader’s own: opens a page that changes it. English: “Change”</extracomment>
        <translation>更改</translation>
    </message>
    <message>
        <source>PLACE_CHANGE_ONE</source>
        <extracomment>Title of that page, and the spoken name of that button; %@ is the place’s name. English: “Change %@”</extracomment>
        <translation>更改%@</translation>
    </message>
    <message>
        <source>PLACE_KIND</source>
        <extracomment>Label of a choice: what kind of place it is; below it PLACE_KIND_NONE, PLACE_KIND_HOME and so on. English: “Kind”</extracomment>
        <translation>类型</translation>
    </message>
    <message>
        <source>PLACE_KIND_NONE</source>
        <extracomment>In the choice PLACE_KIND: no kind. English: “None”</extracomment>
        <translation>无</translation>
    </message>
    <message>
        <source>PLACE_KIND_HOME</source>
        <extracomment>In the choice PLACE_KIND. English: “Home”</extracomment>
        <translation>家</translation>
    </message>
    <message>
        <source>PLACE_KIND_WORK</source>
        <extracomment>In the choice PLACE_KIND. English: “Work”</extracomment>
        <translation>工作单位</translation>
    </message>
    <message>
        <source>PLACE_KIND_SCHOOL</source>
        <extracomment>In the choice PLACE_KIND. English: “School”</extracomment>
        <translation>学校</translation>
    </message>
    <message>
        <source>PLACE_KIND_GYM</source>
        <extracomment>In the choice PLACE_KIND. English: “Gym”</extracomment>
        <translation>健身房</translation>
    </message>
    <message>
        <source>PLACE_KIND_OTHER</source>
        <extracomment>In the choice PLACE_KIND. English: “Other”</extracomment>
        <translation>其他地点</translation>
    </message>
    <message>
        <source>PLACE_TAKEN</source>
        <extracomment>Complaint when a place is given a name that another one has. English: “Another place of yours has this name.”</extracomment>
        <translation>您的另一个地点已使用此名称。</translation>
    </message>
    <message>
        <source>NEAR_TOWN</source>
        <extracomment>Where somebody is: %1$@ is the nearest town in the nominative, %2$@ how far away it is (“40 km”). English: “near %1$@, %2$@”</extracomment>
        <translation>%1$@附近，%2$@</translation>
    </message>
    <message>
        <source>STREET_IN_TOWN</source>
        <extracomment>Where somebody is: %1$@ is a street, %2$@ its town; change their order where the language does. English: “%1$@, %2$@”</extracomment>
        <translation>%2$@ %1$@</translation>
    </message>
    <message>
        <source>COORDINATES</source>
        <extracomment>Where somebody is, where nothing has a name: %1$@ is DEGREES_NORTH or DEGREES_SOUTH, %2$@ DEGREES_EAST or DEGREES_WEST. English: “%1$@, %2$@”</extracomment>
        <translation>%1$@，%2$@</translation>
    </message>
    <message>
        <source>DEGREES_NORTH</source>
        <extracomment>A latitude; %@ is a number with two decimals. English: “%@° north”</extracomment>
        <translation>北纬%@°</translation>
    </message>
    <message>
        <source>DEGREES_SOUTH</source>
        <extracomment>A latitude; %@ is a number with two decimals. English: “%@° south”</extracomment>
        <translation>南纬%@°</translation>
    </message>
    <message>
        <source>DEGREES_EAST</source>
        <extracomment>A longitude; %@ is a number with two decimals. English: “%@° east”</extracomment>
        <translation>东经%@°</translation>
    </message>
    <message>
        <source>DEGREES_WEST</source>
        <extracomment>A longitude; %@ is a number with two decimals. English: “%@° west”</extracomment>
        <translation>西经%@°</translation>
    </message>
    <message>
        <source>LINK_COMPUTER</source>
        <extracomment>A button: makes a link with which the program on a computer signs in; and the title of the page that shows it. English: “Sign in on a computer”</extracomment>
        <translation>在电脑上登录</translation>
    </message>
    <message>
        <source>LINK_COMPUTER_TEXT</source>
        <extracomment>Above the link. English: “Paste this link into ktr on the computer. It works once, within 15 minutes.”</extracomment>
        <translation>将此链接粘贴到电脑上的 ktr 中。15 分钟内可使用一次。</translation>
    </message>
</context>
</TS>
