<?xml version="1.0" encoding="utf-8"?>
<!DOCTYPE TS>
<TS version="2.1" language="en" sourcelanguage="en">
<context>
    <name>Localizable</name>
    <message>
        <source>VISIBLE_TO</source>
        <extracomment>Title of the people's page; %@ is the number, in words from NUMBERS or in digits</extracomment>
        <translation>{0, plural, one{%@ person can see where you are.} other{%@ people can see where you are.}}</translation>
    </message>
    <message>
        <source>NUMBERS</source>
        <extracomment>The numbers from one to twelve as they begin VISIBLE_TO, in its gender and case, with a bar between; a hyphen alone where digits are usual</extracomment>
        <translation>One|Two|Three|Four|Five|Six|Seven|Eight|Nine|Ten|Eleven|Twelve</translation>
    </message>
    <message>
        <source>VISIBLE_TO_NOBODY</source>
        <extracomment>Title of the people's page while the reader hides or shares with nobody</extracomment>
        <translation>Nobody can see where you are.</translation>
    </message>
    <message>
        <source>VISIBLE</source>
        <extracomment>Label of the one switch over everything</extracomment>
        <translation>Visible to friends</translation>
    </message>
    <message>
        <source>VISIBLE_ON</source>
        <extracomment>Below VISIBLE while the switch is on</extracomment>
        <translation>Off hides you from everyone at once.</translation>
    </message>
    <message>
        <source>VISIBLE_OFF</source>
        <extracomment>Below VISIBLE while the switch is off</extracomment>
        <translation>Turn on, and the rules below hold again.</translation>
    </message>
    <message>
        <source>SWITCH_ON</source>
        <extracomment>Spoken: a switch, %@ is its label, is on</extracomment>
        <translation>%@, on</translation>
    </message>
    <message>
        <source>SWITCH_OFF</source>
        <extracomment>Spoken: a switch, %@ is its label, is off</extracomment>
        <translation>%@, off</translation>
    </message>
    <message>
        <source>WHO_SEES_ME</source>
        <extracomment>Heading above the list of people who see the reader</extracomment>
        <translation>Who sees me</translation>
    </message>
    <message>
        <source>EXACTLY</source>
        <extracomment>How exactly somebody is seen</extracomment>
        <translation>Exactly</translation>
    </message>
    <message>
        <source>WITHIN_1_KM</source>
        <extracomment>How exactly somebody is seen</extracomment>
        <translation>Within 1 km</translation>
    </message>
    <message>
        <source>TOWN</source>
        <extracomment>How exactly somebody is seen</extracomment>
        <translation>The town</translation>
    </message>
    <message>
        <source>NAMED_PLACES</source>
        <extracomment>How exactly somebody is seen: only when they are at one of their named places</extracomment>
        <translation>Only places I have named</translation>
    </message>
    <message>
        <source>RULE_ALWAYS</source>
        <extracomment>A rule: %@ is how exactly</extracomment>
        <translation>%@, always</translation>
    </message>
    <message>
        <source>RULE_MIDNIGHT</source>
        <extracomment>A rule that ends at the next midnight: %@ is how exactly</extracomment>
        <translation>%@, until midnight</translation>
    </message>
    <message>
        <source>RULE_TIME</source>
        <extracomment>A rule that ends: %1$@ is how exactly, %2$@ a time or a day and time</extracomment>
        <translation>%1$@, until %2$@</translation>
    </message>
    <message>
        <source>RULE_PLACE</source>
        <extracomment>A rule that ends when the reader arrives: %1$@ is how exactly, %2$@ the reader's name of a place</extracomment>
        <translation>%1$@, until you are at %2$@</translation>
    </message>
    <message>
        <source>RULE_ENDED</source>
        <extracomment>In place of a rule that is over: %@ is a day and time</extracomment>
        <translation>Ended: %@</translation>
    </message>
    <message>
        <source>RULE_ASKED</source>
        <extracomment>A rule without an end asks now and then whether it is still meant; %@ is the day on which it ends without an answer</extracomment>
        <translation>Still meant? Without an answer it ends: %@.</translation>
    </message>
    <message>
        <source>KEEP_SHARING</source>
        <extracomment>Button: the rule goes on</extracomment>
        <translation>Keep sharing</translation>
    </message>
    <message>
        <source>SHARE_WITH</source>
        <extracomment>Row or button that begins a new rule</extracomment>
        <translation>Share with somebody</translation>
    </message>
    <message>
        <source>ASKED_TITLE</source>
        <extracomment>Above those who asked the reader to share</extracomment>
        <translation>Would like to see where you are</translation>
    </message>
    <message>
        <source>ASKED_SHARE</source>
        <extracomment>Button beside somebody who asked: leads to the page of a rule</extracomment>
        <translation>Share</translation>
    </message>
    <message>
        <source>ASKED_NOT_NOW</source>
        <extracomment>Button beside it: the request goes, nobody hears of it</extracomment>
        <translation>Not now</translation>
    </message>
    <message>
        <source>SHARE_WHO</source>
        <extracomment>Label of a field</extracomment>
        <translation>Name, e-mail address or phone number</translation>
    </message>
    <message>
        <source>SHARE_UNKNOWN</source>
        <extracomment>Nobody was found by what was typed</extracomment>
        <translation>Nobody here is called so. Whoever runs the service can add people.</translation>
    </message>
    <message>
        <source>SHARE_SELF</source>
        <extracomment>The reader typed their own name</extracomment>
        <translation>Nobody shares with themselves.</translation>
    </message>
    <message>
        <source>GO_ON</source>
        <extracomment>Button: to the next step</extracomment>
        <translation>Go on</translation>
    </message>
    <message>
        <source>WHO_LOOKED</source>
        <extracomment>Heading above the list of people who looked</extracomment>
        <translation>Who looked</translation>
    </message>
    <message>
        <source>ALL_LOOKS</source>
        <extracomment>Row that opens all that is kept of who looked; %@ is a number of days</extracomment>
        <translation>{0, plural, one{All of the last day} other{All of the last %@ days}}</translation>
    </message>
    <message>
        <source>NOBODY_LOOKED</source>
        <extracomment>No entry in the list of people who looked</extracomment>
        <translation>Nobody has looked.</translation>
    </message>
    <message>
        <source>CARRIED</source>
        <extracomment>After the name of who looked: their phone fetched it by itself, nobody asked</extracomment>
        <translation>by their phone alone</translation>
    </message>
    <message>
        <source>MY_DATA</source>
        <extracomment>Heading</extracomment>
        <translation>My phone and my data</translation>
    </message>
    <message>
        <source>SET_UP_PHONE</source>
        <extracomment>Row and title</extracomment>
        <translation>Set up a phone</translation>
    </message>
    <message>
        <source>MY_DEVICES</source>
        <extracomment>Row and title: list of phones, programs and browsers</extracomment>
        <translation>My devices</translation>
    </message>
    <message>
        <source>MY_SETTINGS</source>
        <extracomment>Row and title: language, time zone, how long things are kept</extracomment>
        <translation>Settings</translation>
    </message>
    <message>
        <source>GET_COPY</source>
        <extracomment>Row: a file with everything about the reader</extracomment>
        <translation>Get a copy of my data</translation>
    </message>
    <message>
        <source>DELETE_ALL</source>
        <extracomment>Row and title</extracomment>
        <translation>Delete everything about me</translation>
    </message>
    <message>
        <source>SIGN_OUT</source>
        <extracomment>Button</extracomment>
        <translation>Sign out</translation>
    </message>
    <message>
        <source>BACK</source>
        <extracomment>Spoken: the arrow back</extracomment>
        <translation>Back</translation>
    </message>
    <message>
        <source>SEES_TITLE</source>
        <extracomment>Title of the page about one rule; %@ is a name</extracomment>
        <translation>What %@ sees</translation>
    </message>
    <message>
        <source>SEES_THIS</source>
        <extracomment>Below a row that shows the reader as %@ sees them</extracomment>
        <translation>%@ sees you exactly like this.</translation>
    </message>
    <message>
        <source>SEES_NOTHING</source>
        <extracomment>In place of that row; %@ is a name</extracomment>
        <translation>%@ sees no place of yours now.</translation>
    </message>
    <message>
        <source>A_PLACE_WITHIN</source>
        <extracomment>In that row: a place that is known within a distance, %@</extracomment>
        <translation>Within %@</translation>
    </message>
    <message>
        <source>HOW_EXACTLY</source>
        <extracomment>Heading above a choice</extracomment>
        <translation>How exactly</translation>
    </message>
    <message>
        <source>UNTIL</source>
        <extracomment>Heading above a choice</extracomment>
        <translation>Until</translation>
    </message>
    <message>
        <source>UNTIL_CHANGED</source>
        <extracomment>Choice of when a rule ends: not by itself</extracomment>
        <translation>I change it</translation>
    </message>
    <message>
        <source>UNTIL_MIDNIGHT</source>
        <extracomment>Choice of when a rule ends</extracomment>
        <translation>Midnight</translation>
    </message>
    <message>
        <source>UNTIL_ARRIVAL</source>
        <extracomment>Choice of when a rule ends; a list of places follows</extracomment>
        <translation>I arrive at</translation>
    </message>
    <message>
        <source>UNTIL_TIME</source>
        <extracomment>Choice of when a rule ends; a field for a time follows</extracomment>
        <translation>A time</translation>
    </message>
    <message>
        <source>SAID_ALOUD</source>
        <extracomment>Label of a box to tick: speakers may say where the reader is</extracomment>
        <translation>May be said aloud</translation>
    </message>
    <message>
        <source>SAID_ALOUD_WHERE</source>
        <extracomment>Below SAID_ALOUD; %@ is a name</extracomment>
        <translation>Speakers at %@’s may say it</translation>
    </message>
    <message>
        <source>SAVE</source>
        <extracomment>Button</extracomment>
        <translation>Save</translation>
    </message>
    <message>
        <source>STOP</source>
        <extracomment>Button and title; %@ is a name</extracomment>
        <translation>Stop sharing with %@</translation>
    </message>
    <message>
        <source>STOP_ASK</source>
        <extracomment>Asks before STOP; %@ is a name</extracomment>
        <translation>%@ will see nothing of you from now on. What their phone has shown stays on it.</translation>
    </message>
    <message>
        <source>KEEP</source>
        <extracomment>Button: do not stop, do not delete</extracomment>
        <translation>Keep</translation>
    </message>
    <message>
        <source>STEP_INSTALL</source>
        <extracomment>First step of setting up a phone</extracomment>
        <translation>Install a tracker app that can send to an address of your own.</translation>
    </message>
    <message>
        <source>STEP_TYPE</source>
        <extracomment>Second step; three values follow</extracomment>
        <translation>Type these three into it.</translation>
    </message>
    <message>
        <source>STEP_RUN</source>
        <extracomment>Third step</extracomment>
        <translation>Let it run, then look again: the phone’s first place shows up here.</translation>
    </message>
    <message>
        <source>ADDRESS</source>
        <extracomment>Label of a value to type</extracomment>
        <translation>Address</translation>
    </message>
    <message>
        <source>USER</source>
        <extracomment>Label of a value to type</extracomment>
        <translation>User</translation>
    </message>
    <message>
        <source>PASSWORD</source>
        <extracomment>Label of a value to type</extracomment>
        <translation>Password</translation>
    </message>
    <message>
        <source>SHOWN_ONCE</source>
        <extracomment>Warning below the values</extracomment>
        <translation>This password is shown once. For another phone, set up another.</translation>
    </message>
    <message>
        <source>WAS_SHOWN</source>
        <extracomment>In place of the password; %@ is a day</extracomment>
        <translation>Shown once: %@.</translation>
    </message>
    <message>
        <source>ADDRESS_ALONE</source>
        <extracomment>Above an address for apps that take nothing else</extracomment>
        <translation>For apps that take nothing but an address:</translation>
    </message>
    <message>
        <source>MAKE_PASSWORD</source>
        <extracomment>Button on the first page of setting up a phone</extracomment>
        <translation>Show what to type</translation>
    </message>
    <message>
        <source>NOTHING_YET</source>
        <extracomment>No message of a phone has come</extracomment>
        <translation>Nothing has come yet.</translation>
    </message>
    <message>
        <source>HERE_SINCE</source>
        <extracomment>A phone's first place has come; %1$@ is a time, %2$@ a distance</extracomment>
        <translation>Here since %1$@, within about %2$@.</translation>
    </message>
    <message>
        <source>HERE_SINCE_TIME</source>
        <extracomment>A phone was heard; %@ is a time</extracomment>
        <translation>Here since %@.</translation>
    </message>
    <message>
        <source>LOOK_AGAIN</source>
        <extracomment>Button: loads the page again</extracomment>
        <translation>Look again</translation>
    </message>
    <message>
        <source>OTHER_PHONE</source>
        <extracomment>Above a code for a camera</extracomment>
        <translation>Is the phone another one than this? Point its camera here, and this page opens on it.</translation>
    </message>
    <message>
        <source>CODE</source>
        <extracomment>Spoken: a picture with a code for a camera</extracomment>
        <translation>Code for a camera</translation>
    </message>
    <message>
        <source>DEVICE_PHONE</source>
        <extracomment>A device of the reader's</extracomment>
        <translation>Phone</translation>
    </message>
    <message>
        <source>DEVICE_READER</source>
        <extracomment>A device of the reader's: the program that shows friends</extracomment>
        <translation>Program that asks for friends</translation>
    </message>
    <message>
        <source>DEVICE_BROWSER</source>
        <extracomment>A device of the reader's</extracomment>
        <translation>Browser</translation>
    </message>
    <message>
        <source>DEVICE_THIS</source>
        <extracomment>A device of the reader's: the one in use</extracomment>
        <translation>This browser</translation>
    </message>
    <message>
        <source>DEVICE_HEARD</source>
        <extracomment>Below a device; %@ is a day and time</extracomment>
        <translation>Last heard: %@</translation>
    </message>
    <message>
        <source>DEVICE_SINCE</source>
        <extracomment>Below a device; %@ is a day and time</extracomment>
        <translation>Since: %@</translation>
    </message>
    <message>
        <source>DEVICE_END</source>
        <extracomment>Button: the device may do nothing any more</extracomment>
        <translation>End</translation>
    </message>
    <message>
        <source>DEVICE_END_SPOKEN</source>
        <extracomment>Spoken: the same button; %@ is the device and its day</extracomment>
        <translation>End: %@</translation>
    </message>
    <message>
        <source>DEVICE_ASK</source>
        <extracomment>Asks before DEVICE_END</extracomment>
        <translation>It sends nothing and sees nobody from then on, and what it began ends.</translation>
    </message>
    <message>
        <source>SETTINGS_PLACES_KEPT</source>
        <extracomment>Label of a choice of durations</extracomment>
        <translation>My places are kept for</translation>
    </message>
    <message>
        <source>SETTINGS_LOOKS_KEPT</source>
        <extracomment>Label of a choice of durations</extracomment>
        <translation>Who looked is kept for</translation>
    </message>
    <message>
        <source>SETTINGS_ZONE</source>
        <extracomment>Label of a choice</extracomment>
        <translation>Time zone</translation>
    </message>
    <message>
        <source>SETTINGS_LANGUAGE</source>
        <extracomment>Label of a choice</extracomment>
        <translation>Language</translation>
    </message>
    <message>
        <source>SAVED</source>
        <extracomment>After saving</extracomment>
        <translation>Saved.</translation>
    </message>
    <message>
        <source>DELETE_ASK</source>
        <extracomment>Asks before everything about the reader is deleted</extracomment>
        <translation>Your places, rules, devices and the notes of who looked go for good. Phones of friends keep what they have shown.</translation>
    </message>
    <message>
        <source>DELETE_NOW</source>
        <extracomment>Button</extracomment>
        <translation>Delete everything</translation>
    </message>
    <message>
        <source>DELETED</source>
        <extracomment>After everything was deleted</extracomment>
        <translation>Everything about you is deleted.</translation>
    </message>
    <message>
        <source>LINK_TITLE</source>
        <extracomment>Title of the page that a link opens</extracomment>
        <translation>Your own page</translation>
    </message>
    <message>
        <source>LINK_TEXT</source>
        <extracomment>Below it</extracomment>
        <translation>This link works once. After that this browser stays signed in for 30 days.</translation>
    </message>
    <message>
        <source>LINK_OPEN</source>
        <extracomment>Button</extracomment>
        <translation>Open my page</translation>
    </message>
    <message>
        <source>LINK_SPENT</source>
        <extracomment>The link cannot be used any more</extracomment>
        <translation>This link has been used, or its 15 minutes are over. Ask for another one.</translation>
    </message>
    <message>
        <source>SIGNED_OUT</source>
        <extracomment>Title: nobody is signed in</extracomment>
        <translation>This page opens with a link.</translation>
    </message>
    <message>
        <source>SIGNED_OUT_TEXT</source>
        <extracomment>Below it</extracomment>
        <translation>Whoever runs the service gives you one. It works once, for 15 minutes.</translation>
    </message>
    <message>
        <source>NO_SUCH_PAGE</source>
        <extracomment>Title</extracomment>
        <translation>There is no such page.</translation>
    </message>
    <message>
        <source>NOT_FROM_HERE</source>
        <extracomment>A form that another page sent</extracomment>
        <translation>This did not come from your own page. Nothing has changed.</translation>
    </message>
    <message>
        <source>NOT_KEPT</source>
        <extracomment>The service could not write</extracomment>
        <translation>It could not be kept just now. Nothing has changed; try again in a while.</translation>
    </message>
    <message>
        <source>NOT_UNDERSTOOD</source>
        <extracomment>A form with something missing</extracomment>
        <translation>Something is missing there. Nothing has changed; go back and choose again.</translation>
    </message>
    <message>
        <source>TIME_WANTED</source>
        <extracomment>No time was given beside the choice of one</extracomment>
        <translation>Choose the time at which it ends.</translation>
    </message>
    <message>
        <source>TO_MY_PAGE</source>
        <extracomment>Link</extracomment>
        <translation>To my page</translation>
    </message>
    <message>
        <source>MY_PLACES</source>
        <extracomment>Row and title: places to which the reader gave names</extracomment>
        <translation>My places</translation>
    </message>
    <message>
        <source>PLACE_NONE</source>
        <extracomment>No place has a name</extracomment>
        <translation>No place has a name yet.</translation>
    </message>
    <message>
        <source>PLACE_HERE</source>
        <extracomment>Heading and button</extracomment>
        <translation>Name the place where I am</translation>
    </message>
    <message>
        <source>PLACE_HERE_HINT</source>
        <extracomment>Below PLACE_HERE</extracomment>
        <translation>The place of your phone’s last message, and 150 metres around it.</translation>
    </message>
    <message>
        <source>PLACE_NO_FIX</source>
        <extracomment>Instead of PLACE_HERE_HINT</extracomment>
        <translation>Your phone has sent no place yet.</translation>
    </message>
    <message>
        <source>PLACE_NAME</source>
        <extracomment>Label of a field</extracomment>
        <translation>Name of the place</translation>
    </message>
    <message>
        <source>PLACE_SAID</source>
        <extracomment>Label of a box to tick, and below a place</extracomment>
        <translation>Friends may hear its name</translation>
    </message>
    <message>
        <source>PLACE_UNSAID</source>
        <extracomment>Below a place</extracomment>
        <translation>Nobody hears its name</translation>
    </message>
    <message>
        <source>PLACE_REMOVE</source>
        <extracomment>Button</extracomment>
        <translation>Remove</translation>
    </message>
    <message>
        <source>PLACE_REMOVE_ONE</source>
        <extracomment>Title, and spoken: the same button; %@ is the name of a place</extracomment>
        <translation>Remove: %@</translation>
    </message>
    <message>
        <source>PLACE_REMOVE_ASK</source>
        <extracomment>Asks before PLACE_REMOVE</extracomment>
        <translation>Its name goes, and rules that were to end there end now.</translation>
    </message>
    <message>
        <source>TOLD_MAY</source>
        <extracomment>Label of a switch: whether one person may be told when the reader comes and goes</extracomment>
        <translation>May be told when you come and go</translation>
    </message>
    <message>
        <source>TOLD_MAY_HINT</source>
        <extracomment>Below TOLD_MAY; %@ is EXACTLY, a choice on the same page</extracomment>
        <translation>Holds only with “%@”.</translation>
    </message>
    <message>
        <source>TOLD_TITLE</source>
        <extracomment>Title of the page that lists who is told when the reader comes and goes, and the way there</extracomment>
        <translation>Who is told when I come and go</translation>
    </message>
    <message>
        <source>TOLD_NOBODY</source>
        <extracomment>On the page TOLD_TITLE when the list is empty</extracomment>
        <translation>Nobody is told.</translation>
    </message>
    <message>
        <source>TOLD_LEAVING</source>
        <extracomment>In a row with somebody's name: that person is told when the reader leaves %@, a place</extracomment>
        <translation>When I leave: %@</translation>
    </message>
    <message>
        <source>TOLD_ARRIVING</source>
        <extracomment>In a row with somebody's name: that person is told when the reader arrives at %@, a place</extracomment>
        <translation>When I arrive: %@</translation>
    </message>
    <message>
        <source>PLACE_CHANGE</source>
        <extracomment>Button beside a place of the reader’s own: opens a page that changes it</extracomment>
        <translation>Change</translation>
    </message>
    <message>
        <source>PLACE_CHANGE_ONE</source>
        <extracomment>Title of that page, and the spoken name of that button; %@ is the place’s name</extracomment>
        <translation>Change %@</translation>
    </message>
    <message>
        <source>PLACE_KIND</source>
        <extracomment>Label of a choice: what kind of place it is; below it PLACE_KIND_NONE, PLACE_KIND_HOME and so on</extracomment>
        <translation>Kind</translation>
    </message>
    <message>
        <source>PLACE_KIND_NONE</source>
        <extracomment>In the choice PLACE_KIND: no kind</extracomment>
        <translation>None</translation>
    </message>
    <message>
        <source>PLACE_KIND_HOME</source>
        <extracomment>In the choice PLACE_KIND</extracomment>
        <translation>Home</translation>
    </message>
    <message>
        <source>PLACE_KIND_WORK</source>
        <extracomment>In the choice PLACE_KIND</extracomment>
        <translation>Work</translation>
    </message>
    <message>
        <source>PLACE_KIND_SCHOOL</source>
        <extracomment>In the choice PLACE_KIND</extracomment>
        <translation>School</translation>
    </message>
    <message>
        <source>PLACE_KIND_GYM</source>
        <extracomment>In the choice PLACE_KIND</extracomment>
        <translation>Gym</translation>
    </message>
    <message>
        <source>PLACE_KIND_OTHER</source>
        <extracomment>In the choice PLACE_KIND</extracomment>
        <translation>Other</translation>
    </message>
    <message>
        <source>PLACE_TAKEN</source>
        <extracomment>Complaint when a place is given a name that another one has</extracomment>
        <translation>Another place of yours has this name.</translation>
    </message>
    <message>
        <source>NEAR_TOWN</source>
        <extracomment>Where somebody is: %1$@ is the nearest town in the nominative, %2$@ how far away it is (“40 km”)</extracomment>
        <translation>near %1$@, %2$@</translation>
    </message>
    <message>
        <source>STREET_IN_TOWN</source>
        <extracomment>Where somebody is: %1$@ is a street, %2$@ its town; change their order where the language does</extracomment>
        <translation>%1$@, %2$@</translation>
    </message>
    <message>
        <source>COORDINATES</source>
        <extracomment>Where somebody is, where nothing has a name: %1$@ is DEGREES_NORTH or DEGREES_SOUTH, %2$@ DEGREES_EAST or DEGREES_WEST</extracomment>
        <translation>%1$@, %2$@</translation>
    </message>
    <message>
        <source>DEGREES_NORTH</source>
        <extracomment>A latitude; %@ is a number with two decimals</extracomment>
        <translation>%@° north</translation>
    </message>
    <message>
        <source>DEGREES_SOUTH</source>
        <extracomment>A latitude; %@ is a number with two decimals</extracomment>
        <translation>%@° south</translation>
    </message>
    <message>
        <source>DEGREES_EAST</source>
        <extracomment>A longitude; %@ is a number with two decimals</extracomment>
        <translation>%@° east</translation>
    </message>
    <message>
        <source>DEGREES_WEST</source>
        <extracomment>A longitude; %@ is a number with two decimals</extracomment>
        <translation>%@° west</translation>
    </message>
    <message>
        <source>LINK_COMPUTER</source>
        <extracomment>A button: makes a link with which the program on a computer signs in; and the title of the page that shows it</extracomment>
        <translation>Sign in on a computer</translation>
    </message>
    <message>
        <source>LINK_COMPUTER_TEXT</source>
        <extracomment>Above the link</extracomment>
        <translation>Paste this link into ktr on the computer. It works once, within 15 minutes.</translation>
    </message>
</context>
</TS>
