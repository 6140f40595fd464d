<?xml version="1.0" encoding="utf-8"?>
<!DOCTYPE TS>
<TS version="2.1" language="el" sourcelanguage="en">
<context>
    <name>Localizable</name>
    <message>
        <source>TODAY</source>
        <extracomment>Above a question; %@ is the time of day. English: “Today, %@”</extracomment>
        <translation>Σήμερα, %@</translation>
    </message>
    <message>
        <source>DISTANCE_TEXT</source>
        <extracomment>A frame around each distance (%@, with its unit), for a language that needs one; usually %@ alone. English: “%@”</extracomment>
        <translation>%@</translation>
    </message>
    <message>
        <source>_$!&lt;home&gt;!$_</source>
        <extracomment>A built-in name for a place. English: “Home”</extracomment>
        <translation>Σπίτι</translation>
    </message>
    <message>
        <source>_$!&lt;work&gt;!$_</source>
        <extracomment>A built-in name for a place. English: “Work”</extracomment>
        <translation>Εργασία</translation>
    </message>
    <message>
        <source>_$!&lt;school&gt;!$_</source>
        <extracomment>A built-in name for a place. English: “School”</extracomment>
        <translation>Σχολείο</translation>
    </message>
    <message>
        <source>_$!&lt;gym&gt;!$_</source>
        <extracomment>A built-in name for a place. English: “Gym”</extracomment>
        <translation>Γυμναστήριο</translation>
    </message>
    <message>
        <source>_$!&lt;other&gt;!$_</source>
        <extracomment>A built-in name for a place. English: “Other”</extracomment>
        <translation>Άλλο μέρος</translation>
    </message>
    <message>
        <source>ASK_FIELD</source>
        <extracomment>What stands in the empty field, and its name for a screen reader. English: “Ask about your friends”</extracomment>
        <translation>Ρωτήστε για τους φίλους σας</translation>
    </message>
    <message>
        <source>ASK_SEND</source>
        <extracomment>The button that sends the question. English: “Send”</extracomment>
        <translation>Αποστολή</translation>
    </message>
    <message>
        <source>QUESTION_TOO_LONG</source>
        <extracomment>In place of an answer, where what was typed or pasted is too long to be a question</extracomment>
        <translation>Είναι πολύ μεγάλο για ερώτηση. Κάντε μια πιο σύντομη.</translation>
    </message>
    <message>
        <source>ASK_STOP</source>
        <extracomment>The same button, while an answer is waited for: it gives the question up. English: “Stop asking”</extracomment>
        <translation>Διακοπή της ερώτησης</translation>
    </message>
    <message>
        <source>ASKING_SLOW</source>
        <extracomment>In the answer’s place, when it takes more than four seconds. English: “Taking longer than usual…”</extracomment>
        <translation>Παίρνει περισσότερο από το συνηθισμένο…</translation>
    </message>
    <message>
        <source>STATUS_LIVE_NOW</source>
        <extracomment>Status line: answers keep coming. English: “Live · updated just now”</extracomment>
        <translation>Ζωντανά · ενημερώθηκε μόλις τώρα</translation>
    </message>
    <message>
        <source>STATUS_LIVE_SECONDS</source>
        <extracomment>The same; %@ is a number of seconds. English: “Live · updated %@ s ago”</extracomment>
        <translation>Ζωντανά · ενημερώθηκε πριν από %@ δευτ.</translation>
    </message>
    <message>
        <source>STATUS_LIVE_MINUTES</source>
        <extracomment>The same; %@ is a number of minutes. English: “Live · updated %@ min ago”</extracomment>
        <translation>Ζωντανά · ενημερώθηκε πριν από %@ λεπ.</translation>
    </message>
    <message>
        <source>STATUS_LIVE_HOURS</source>
        <extracomment>The same; %@ is a number of hours. English: “Live · updated %@ h ago”</extracomment>
        <translation>Ζωντανά · ενημερώθηκε πριν από %@ ώ.</translation>
    </message>
    <message>
        <source>STATUS_PAUSED_NOW</source>
        <extracomment>Status line: no more answers come by themselves. English: “Paused · updated just now”</extracomment>
        <translation>Σε παύση · ενημερώθηκε μόλις τώρα</translation>
    </message>
    <message>
        <source>STATUS_PAUSED_SECONDS</source>
        <extracomment>The same; %@ is a number of seconds. English: “Paused · updated %@ s ago”</extracomment>
        <translation>Σε παύση · ενημερώθηκε πριν από %@ δευτ.</translation>
    </message>
    <message>
        <source>STATUS_PAUSED_MINUTES</source>
        <extracomment>The same; %@ is a number of minutes. English: “Paused · updated %@ min ago”</extracomment>
        <translation>Σε παύση · ενημερώθηκε πριν από %@ λεπ.</translation>
    </message>
    <message>
        <source>STATUS_PAUSED_HOURS</source>
        <extracomment>The same; %@ is a number of hours. English: “Paused · updated %@ h ago”</extracomment>
        <translation>Σε παύση · ενημερώθηκε πριν από %@ ώ.</translation>
    </message>
    <message>
        <source>STATUS_FINDING_YOU</source>
        <extracomment>Status line: the user's own position is looked for. English: “Finding where you are…”</extracomment>
        <translation>Αναζήτηση της τοποθεσίας σας…</translation>
    </message>
    <message>
        <source>STATUS_HIDDEN</source>
        <extracomment>The status line while friends cannot see where the user is. English: “Your location is hidden”</extracomment>
        <translation>Η τοποθεσία σας είναι κρυφή</translation>
    </message>
    <message>
        <source>STATUS_ASKING</source>
        <extracomment>Status line: a question waits for its answer. English: “Asking…”</extracomment>
        <translation>Υποβολή ερώτησης…</translation>
    </message>
    <message>
        <source>STATUS_OFFLINE</source>
        <extracomment>Status line: the service cannot be reached, and nothing is on screen. English: “Offline.”</extracomment>
        <translation>Εκτός σύνδεσης.</translation>
    </message>
    <message>
        <source>STATUS_OFFLINE_SINCE</source>
        <extracomment>The same with an answer on screen; %@ is the time of day when it was known. English: “Offline. Showing what was known at %@.”</extracomment>
        <translation>Εκτός σύνδεσης. Τελευταία γνωστά στοιχεία: %@.</translation>
    </message>
    <message>
        <source>STATUS_FAULTY</source>
        <extracomment>Status line: the service answers, but with an error, or not in its own words; nothing is on screen. English: “Service error.”</extracomment>
        <translation>Σφάλμα υπηρεσίας.</translation>
    </message>
    <message>
        <source>STATUS_FAULTY_SINCE</source>
        <extracomment>The same with an answer on screen; %@ is the time of day when it was known. English: “Service error. Showing what was known at %@.”</extracomment>
        <translation>Σφάλμα υπηρεσίας. Τελευταία γνωστά στοιχεία: %@.</translation>
    </message>
    <message>
        <source>STATUS_UNTRUSTED</source>
        <extracomment>Status line: whoever answers cannot prove to be the service; nothing is on screen. English: “Service not trusted.”</extracomment>
        <translation>Μη αξιόπιστη υπηρεσία.</translation>
    </message>
    <message>
        <source>STATUS_UNTRUSTED_SINCE</source>
        <extracomment>The same with an answer on screen; %@ is the time of day when it was known. English: “Service not trusted. Showing what was known at %@.”</extracomment>
        <translation>Μη αξιόπιστη υπηρεσία. Τελευταία γνωστά στοιχεία: %@.</translation>
    </message>
    <message>
        <source>STATUS_SIGN_IN</source>
        <extracomment>Status line: the service does not take the account's credentials, or there is no account. English: “Sign in again to see your friends.”</extracomment>
        <translation>Συνδεθείτε ξανά για να δείτε τους φίλους σας.</translation>
    </message>
    <message>
        <source>STATUS_SIGN_IN_FIRST</source>
        <extracomment>Status line: nobody has signed in on this computer yet</extracomment>
        <translation>Συνδεθείτε για να δείτε τους φίλους σας.</translation>
    </message>
    <message>
        <source>SIGN_IN_TITLE</source>
        <extracomment>Title of the page for signing in</extracomment>
        <translation>Πού είναι οι φίλοι σας;</translation>
    </message>
    <message>
        <source>SIGN_IN_LINE</source>
        <extracomment>Below that title</extracomment>
        <translation>Συνδεθείτε στην υπηρεσία όπου μοιράζεστε μέρη. Μπορεί να είναι δική σας.</translation>
    </message>
    <message>
        <source>SIGN_IN_ADDRESS</source>
        <extracomment>Label of a field: the address of the service</extracomment>
        <translation>Διεύθυνση υπηρεσίας</translation>
    </message>
    <message>
        <source>SIGN_IN_YOU</source>
        <extracomment>Label of a field: who signs in</extracomment>
        <translation>Εσείς</translation>
    </message>
    <message>
        <source>SIGN_IN_SECRET</source>
        <extracomment>Label of a field: the password</extracomment>
        <translation>Μυστικό</translation>
    </message>
    <message>
        <source>SIGN_IN_GO</source>
        <extracomment>Button: signs in</extracomment>
        <translation>Σύνδεση</translation>
    </message>
    <message>
        <source>SIGN_IN_CHECKING</source>
        <extracomment>On that button while the service is asked</extracomment>
        <translation>Έλεγχος…</translation>
    </message>
    <message>
        <source>SIGN_IN_CANCEL</source>
        <extracomment>Button: ends the asking</extracomment>
        <translation>Ακύρωση</translation>
    </message>
    <message>
        <source>SIGN_IN_RETRY</source>
        <extracomment>Button: asks again after nothing answered</extracomment>
        <translation>Νέα προσπάθεια</translation>
    </message>
    <message>
        <source>SIGN_IN_SHOW</source>
        <extracomment>Spoken: a button that shows the letters of the secret</extracomment>
        <translation>Εμφάνιση του μυστικού</translation>
    </message>
    <message>
        <source>SIGN_IN_HIDE</source>
        <extracomment>Spoken: a button that hides them again</extracomment>
        <translation>Απόκρυψη του μυστικού</translation>
    </message>
    <message>
        <source>SIGN_IN_KEYRING</source>
        <extracomment>Small, below the fields</extracomment>
        <translation>Το μυστικό σας μένει στην κλειδοθήκη αυτού του υπολογιστή.</translation>
    </message>
    <message>
        <source>SIGN_IN_UNKNOWN</source>
        <extracomment>Below the secret; does not tell which of the two is wrong</extracomment>
        <translation>Η υπηρεσία δεν γνωρίζει αυτό το άτομο με αυτό το μυστικό. Ελέγξτε και τα δύο ή ζητήστε νέο μυστικό.</translation>
    </message>
    <message>
        <source>SIGN_IN_NOTHING_ANSWERS</source>
        <extracomment>Below the address, which is %@</extracomment>
        <translation>Κανείς δεν απαντά στο %@. Ελέγξτε τη διεύθυνση και τη σύνδεση του υπολογιστή.</translation>
    </message>
    <message>
        <source>SIGN_IN_NOT_TRUSTED</source>
        <extracomment>Below the address, which is %@: its certificate is not valid</extracomment>
        <translation>Ό,τι απαντά στο %@ δεν μπορεί να αποδείξει ότι είναι η υπηρεσία σας, οπότε δεν στάλθηκε τίποτα.</translation>
    </message>
    <message>
        <source>SIGN_IN_NO_SERVICE</source>
        <extracomment>Below the address, which is %@: it is some other web server</extracomment>
        <translation>Κάτι άλλο απαντά στο %@. Ελέγξτε τη διεύθυνση.</translation>
    </message>
    <message>
        <source>SIGN_IN_FAILING</source>
        <extracomment>Below the address, which is %@: the service reports a failure of its own</extracomment>
        <translation>Το %@ δεν μπορεί να βοηθήσει τώρα.</translation>
    </message>
    <message>
        <source>SIGN_IN_BAD_ADDRESS</source>
        <extracomment>Below the address; keep brin.example as it is</extracomment>
        <translation>Μια διεύθυνση μοιάζει έτσι: brin.example.</translation>
    </message>
    <message>
        <source>SIGN_IN_LOCKED</source>
        <extracomment>The system's keyring is locked or missing</extracomment>
        <translation>Η κλειδοθήκη είναι κλειστή. Ξεκλειδώστε την ή φυλάξτε το μυστικό σε αρχείο που διαβάζετε μόνο εσείς.</translation>
    </message>
    <message>
        <source>SIGN_IN_UNLOCK</source>
        <extracomment>Button: tries the keyring again</extracomment>
        <translation>Ξεκλείδωμα κλειδοθήκης</translation>
    </message>
    <message>
        <source>SIGN_IN_IN_FILE</source>
        <extracomment>Button: keeps the secret in a file instead of the keyring</extracomment>
        <translation>Φύλαξη σε αρχείο</translation>
    </message>
    <message>
        <source>SIGN_IN_NOT_WRITTEN</source>
        <extracomment>The configuration cannot be written</extracomment>
        <translation>Οι ρυθμίσεις σας δεν μπορούν να αποθηκευτούν σε αυτόν τον υπολογιστή.</translation>
    </message>
    <message>
        <source>GREETING_MORNING</source>
        <extracomment>Title of an empty conversation</extracomment>
        <translation>Καλημέρα.</translation>
    </message>
    <message>
        <source>GREETING_AFTERNOON</source>
        <extracomment>Title of an empty conversation</extracomment>
        <translation>Καλό απόγευμα.</translation>
    </message>
    <message>
        <source>GREETING_EVENING</source>
        <extracomment>Title of an empty conversation</extracomment>
        <translation>Καλησπέρα.</translation>
    </message>
    <message>
        <source>GREETING_LINE</source>
        <extracomment>Below that title</extracomment>
        <translation>Ρωτήστε για τους φίλους σας ή αγγίξτε μια ερώτηση.</translation>
    </message>
    <message>
        <source>SUGGEST_FRIENDS</source>
        <extracomment>A question that is asked by a tap</extracomment>
        <translation>Πού είναι οι φίλοι μου;</translation>
    </message>
    <message>
        <source>SUGGEST_NEAR</source>
        <extracomment>A question that is asked by a tap</extracomment>
        <translation>Ποιος είναι κοντά μου;</translation>
    </message>
    <message>
        <source>SUGGEST_HIDE</source>
        <extracomment>A wish that is asked for by a tap</extracomment>
        <translation>Απόκρυψη της τοποθεσίας μου</translation>
    </message>
    <message>
        <source>ANSWER_UNREACHABLE</source>
        <extracomment>Below a question that nobody answered. English: “Your assistant is out of reach right now.”</extracomment>
        <translation>Ο βοηθός σας δεν είναι διαθέσιμος αυτή τη στιγμή.</translation>
    </message>
    <message>
        <source>ANSWER_SIGN_IN</source>
        <extracomment>Below a question that was asked without an account. English: “Sign in to ask about your friends.”</extracomment>
        <translation>Συνδεθείτε για να ρωτήσετε για τους φίλους σας.</translation>
    </message>
    <message>
        <source>ANSWER_NOT_SHOWN</source>
        <extracomment>Below a question whose answer is of a kind that cannot be shown. English: “This answer cannot be shown here.”</extracomment>
        <translation>Αυτή η απάντηση δεν μπορεί να εμφανιστεί εδώ.</translation>
    </message>
    <message>
        <source>ANSWER_RESTRICTED</source>
        <extracomment>Below a question, while the device allows no friends’ locations. English: “Friends’ locations are switched off on this device.”</extracomment>
        <translation>Οι τοποθεσίες φίλων είναι απενεργοποιημένες σε αυτή τη συσκευή.</translation>
    </message>
    <message>
        <source>STATUS_UNREADABLE</source>
        <extracomment>Status line: the configuration is broken. English: “Your settings cannot be read.”</extracomment>
        <translation>Δεν είναι δυνατή η ανάγνωση των ρυθμίσεών σας.</translation>
    </message>
    <message>
        <source>MAP_NOT_AVAILABLE</source>
        <extracomment>In place of a map that nobody can draw. English: “Map not available”</extracomment>
        <translation>Ο χάρτης δεν είναι διαθέσιμος</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_LINK</source>
        <extracomment>What a screen reader would say, written down: %@ can be opened. English: “%@ (link)”</extracomment>
        <translation>%@ (σύνδεσμος)</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_IMAGE</source>
        <extracomment>The same: %@ describes a picture. English: “%@ (image)”</extracomment>
        <translation>%@ (εικόνα)</translation>
    </message>
    <message>
        <source>ANNOUNCE_QUESTION</source>
        <extracomment>A screen reader’s name for what the user asked. English: “Question”</extracomment>
        <translation>Ερώτηση</translation>
    </message>
    <message>
        <source>ANNOUNCE_ANSWER</source>
        <extracomment>A screen reader’s name for the sentence that answers. English: “Answer”</extracomment>
        <translation>Απάντηση</translation>
    </message>
    <message>
        <source>ANNOUNCE_PEOPLE</source>
        <extracomment>Said after the sentence of an answer that has come: %@ is how many people are on it. English: “People: %@.”</extracomment>
        <translation>Άτομα: %@.</translation>
    </message>
    <message>
        <source>ANNOUNCE_PLACE</source>
        <extracomment>Said when a friend (%1$@) has come to another place (%2$@, such as “Fish Market”, “Home” or “Brinmouth, HB”). English: “%1$@: %2$@.”</extracomment>
        <translation>%1$@: %2$@.</translation>
    </message>
    <message>
        <source>ANNOUNCE_UNSEEN</source>
        <extracomment>Said when the place of a friend (%@) is not told any more. English: “%@ is no longer visible.”</extracomment>
        <translation>%@: η τοποθεσία δεν φαίνεται πια.</translation>
    </message>
    <message>
        <source>ANNOUNCE_SEEN</source>
        <extracomment>Said when the place (%2$@) of a friend (%1$@) is known again. English: “%1$@ is visible again: %2$@.”</extracomment>
        <translation>%1$@: η τοποθεσία φαίνεται ξανά: %2$@.</translation>
    </message>
    <message>
        <source>ANNOUNCE_SEEN_SOMEWHERE</source>
        <extracomment>The same for a place without a name. English: “%@ is visible again.”</extracomment>
        <translation>%@: η τοποθεσία φαίνεται ξανά.</translation>
    </message>
    <message>
        <source>ANNOUNCE_UNREACHABLE</source>
        <extracomment>Said when the friends’ service cannot be reached any more. English: “Your friends are out of reach. What is shown may be old.”</extracomment>
        <translation>Δεν υπάρχει επικοινωνία με τους φίλους σας. Ό,τι εμφανίζεται μπορεί να είναι παλιό.</translation>
    </message>
    <message>
        <source>ANNOUNCE_REACHABLE</source>
        <extracomment>Said when it can be reached again. English: “Your friends are within reach again.”</extracomment>
        <translation>Υπάρχει ξανά επικοινωνία με τους φίλους σας.</translation>
    </message>
    <message>
        <source>ANNOUNCE_NEXT</source>
        <extracomment>Two sentences that are said one after the other, as the language parts them; each has its full stop. English: “%1$@ %2$@”</extracomment>
        <translation>%1$@ %2$@</translation>
    </message>
    <message>
        <source>LINK_NOBODY</source>
        <extracomment>A tap on a link that no program opens</extracomment>
        <translation>Κανένα πρόγραμμα σε αυτόν τον υπολογιστή δεν ανοίγει συνδέσμους.</translation>
    </message>
    <message>
        <source>PLACE_NOBODY</source>
        <extracomment>The same, of a place on the map</extracomment>
        <translation>Κανένα πρόγραμμα σε αυτόν τον υπολογιστή δεν ανοίγει τοποθεσίες.</translation>
    </message>
    <message>
        <source>CALL_NOBODY</source>
        <extracomment>The same, of a call</extracomment>
        <translation>Κανένα πρόγραμμα σε αυτόν τον υπολογιστή δεν κάνει κλήσεις.</translation>
    </message>
    <message>
        <source>WRITE_NOBODY</source>
        <extracomment>The same, of a message</extracomment>
        <translation>Κανένα πρόγραμμα σε αυτόν τον υπολογιστή δεν γράφει μηνύματα.</translation>
    </message>
    <message>
        <source>LINK_REFUSED</source>
        <extracomment>A link of a kind that this program does not open</extracomment>
        <translation>Αυτός ο σύνδεσμος δεν ανοίγει εδώ.</translation>
    </message>
    <message>
        <source>LINK_UNKNOWN</source>
        <extracomment>A link from elsewhere about nobody who is among the user’s friends</extracomment>
        <translation>Δεν ξέρω για ποιον είναι αυτός ο σύνδεσμος.</translation>
    </message>
    <message>
        <source>FRIEND_CALL</source>
        <extracomment>Under a round button: calls the friend</extracomment>
        <translation>Κλήση</translation>
    </message>
    <message>
        <source>FRIEND_WRITE</source>
        <extracomment>Under a round button: writes to the friend</extracomment>
        <translation>Γράψτε</translation>
    </message>
    <message>
        <source>FRIEND_MAPS</source>
        <extracomment>Under a round button: opens the place in a program for maps</extracomment>
        <translation>Άνοιγμα σε χάρτες</translation>
    </message>
    <message>
        <source>FRIEND_COPY</source>
        <extracomment>Under a round button: puts the place into the clipboard</extracomment>
        <translation>Αντιγραφή θέσης</translation>
    </message>
    <message>
        <source>FRIEND_COPIED</source>
        <extracomment>In the place of “Copy place”, for two seconds after it was pressed</extracomment>
        <translation>Αντιγράφηκε</translation>
    </message>
    <message>
        <source>FRIEND_SHOW</source>
        <extracomment>A button: brings the friend (%@) back into view on the map</extracomment>
        <translation>Εμφάνιση: %@</translation>
    </message>
    <message>
        <source>FRIEND_WHERE</source>
        <extracomment>A button that asks where a friend (%@) is</extracomment>
        <translation>Πού βρίσκεται: %@;</translation>
    </message>
    <message>
        <source>FRIEND_NOT_SEEN</source>
        <extracomment>A friend (%@) whose place is not to be seen</extracomment>
        <translation>Δεν μπορώ να δω πού βρίσκεται: %@.</translation>
    </message>
    <message>
        <source>MAP_CLOSER</source>
        <extracomment>A button on the map, spoken: zooms in</extracomment>
        <translation>Πιο κοντά</translation>
    </message>
    <message>
        <source>MAP_FURTHER</source>
        <extracomment>A button on the map, spoken: zooms out</extracomment>
        <translation>Πιο μακριά</translation>
    </message>
    <message>
        <source>MAP_SPOKEN</source>
        <extracomment>The map of a friend’s page, spoken; %@ is the friend</extracomment>
        <translation>Χάρτης γύρω από: %@</translation>
    </message>
    <message>
        <source>HOW_FEW</source>
        <extracomment>How exactly a place is known: up to 15 metres</extracomment>
        <translation>Με ακρίβεια λίγων μέτρων</translation>
    </message>
    <message>
        <source>HOW_WITHIN</source>
        <extracomment>The same; %@ is a distance with its unit</extracomment>
        <translation>Με ακρίβεια περίπου %@</translation>
    </message>
    <message>
        <source>HOW_NEAR</source>
        <extracomment>The same, of a wide place; %@ is a distance with its unit</extracomment>
        <translation>Κάπου κοντά, με ακρίβεια περίπου %@</translation>
    </message>
    <message>
        <source>PAGE_FRIENDS</source>
        <extracomment>The name of the page with the list of friends</extracomment>
        <translation>Φίλοι</translation>
    </message>
    <message>
        <source>PAGE_FRIENDS_NONE</source>
        <extracomment>On that page, when nobody was asked about</extracomment>
        <translation>Δεν έχει ζητηθεί ακόμη κανείς.</translation>
    </message>
    <message>
        <source>PAGE_ME</source>
        <extracomment>The name of the user’s own page</extracomment>
        <translation>Η θέση μου</translation>
    </message>
    <message>
        <source>SHARING_SWITCH</source>
        <extracomment>A switch on that page</extracomment>
        <translation>Οι φίλοι με βλέπουν</translation>
    </message>
    <message>
        <source>SHARING_ON</source>
        <extracomment>Under that switch, while it is on</extracomment>
        <translation>Όσοι επιτρέπετε βλέπουν πού είστε.</translation>
    </message>
    <message>
        <source>SHARING_OFF</source>
        <extracomment>Under that switch, while it is off</extracomment>
        <translation>Κανείς δεν βλέπει πού είστε.</translation>
    </message>
    <message>
        <source>SHARING_UNKNOWN</source>
        <extracomment>Under that switch, while the service has not been told anything by it</extracomment>
        <translation>Η υπηρεσία σας δεν το έχει πει ακόμη.</translation>
    </message>
    <message>
        <source>SHARING_FAILED</source>
        <extracomment>Under that switch, when the wish did not reach the service</extracomment>
        <translation>Η υπηρεσία σας δεν απάντησε. Εδώ δεν άλλαξε τίποτα.</translation>
    </message>
    <message>
        <source>MAP_NO_STREETS</source>
        <extracomment>Under a card whose map has no streets</extracomment>
        <translation>Δεν υπάρχουν ακόμη δρόμοι για αυτή την περιοχή.</translation>
    </message>
    <message>
        <source>MAP_GET_STREETS</source>
        <extracomment>Beside it, a button: chooses a file with a map</extracomment>
        <translation>Λήψη δρόμων</translation>
    </message>
    <message>
        <source>MAP_NO_PLACE</source>
        <extracomment>On the plain ground of a map whose friend has no place</extracomment>
        <translation>Καμία θέση</translation>
    </message>
    <message>
        <source>MENU_CUT</source>
        <extracomment>In the menu of the field</extracomment>
        <translation>Αποκοπή</translation>
    </message>
    <message>
        <source>MENU_COPY</source>
        <extracomment>In the menu of the field and of the conversation</extracomment>
        <translation>Αντιγραφή</translation>
    </message>
    <message>
        <source>MENU_PASTE</source>
        <extracomment>In the menu of the field</extracomment>
        <translation>Επικόλληση</translation>
    </message>
    <message>
        <source>MENU_SELECT_ALL</source>
        <extracomment>In the menu of the field</extracomment>
        <translation>Επιλογή όλων</translation>
    </message>
    <message>
        <source>WATCH_ARRIVAL</source>
        <extracomment>A notification about a friend, below the name: the friend has arrived at %@, a place with a name, or a time such as 17:42. English: “Arrived: %@”</extracomment>
        <translation>Άφιξη: %@</translation>
    </message>
    <message>
        <source>WATCH_DEPARTURE</source>
        <extracomment>A notification about a friend, below the name: the friend has left %@, a place with a name, or a time such as 17:42. English: “Left: %@”</extracomment>
        <translation>Αναχώρηση: %@</translation>
    </message>
    <message>
        <source>WATCH_SOMEBODY_ARRIVED</source>
        <extracomment>A notification while the screen is locked: it says neither who nor where. English: “Somebody arrived”</extracomment>
        <translation>Κάποιος έφτασε</translation>
    </message>
    <message>
        <source>WATCH_SOMEBODY_LEFT</source>
        <extracomment>A notification while the screen is locked: it says neither who nor where. English: “Somebody left”</extracomment>
        <translation>Κάποιος έφυγε</translation>
        <source>PAGE_BACK</source>
        <extracomment>The way back from a page, spoken</extracomment>
        <translation>Πίσω</translation>
    </message>
    <message>
        <source>SETTINGS</source>
        <extracomment>The name of the page with the user’s settings, and spoken of the button that opens it. English: “Settings”</extracomment>
        <translation>Ρυθμίσεις</translation>
    </message>
    <message>
        <source>SETTINGS_SIGN_OUT</source>
        <extracomment>A button on that page. English: “Sign out”</extracomment>
        <translation>Αποσύνδεση</translation>
    </message>
    <message>
        <source>SETTINGS_SHARING</source>
        <extracomment>The name of a section of that page. English: “Sharing”</extracomment>
        <translation>Κοινή χρήση</translation>
    </message>
    <message>
        <source>SETTINGS_WHO</source>
        <extracomment>Leads to the service’s own page in a browser. English: “Who sees what”</extracomment>
        <translation>Ποιος βλέπει τι</translation>
    </message>
    <message>
        <source>SETTINGS_READING</source>
        <extracomment>The name of a section. English: “Reading”</extracomment>
        <translation>Ανάγνωση</translation>
    </message>
    <message>
        <source>SETTINGS_TEXT_SIZE</source>
        <extracomment>A setting; its value is one of the sizes below. English: “Text size”</extracomment>
        <translation>Μέγεθος κειμένου</translation>
    </message>
    <message>
        <source>SETTINGS_SMALLER</source>
        <extracomment>Spoken: a button beside it. English: “Smaller text”</extracomment>
        <translation>Μικρότερο κείμενο</translation>
    </message>
    <message>
        <source>SETTINGS_LARGER</source>
        <extracomment>Spoken: a button beside it. English: “Larger text”</extracomment>
        <translation>Μεγαλύτερο κείμενο</translation>
    </message>
    <message>
        <source>SIZE_XS</source>
        <extracomment>A text size. English: “Smallest”</extracomment>
        <translation>Ελάχιστο</translation>
    </message>
    <message>
        <source>SIZE_S</source>
        <extracomment>A text size. English: “Smaller”</extracomment>
        <translation>Μικρότερο</translation>
    </message>
    <message>
        <source>SIZE_M</source>
        <extracomment>A text size. English: “Small”</extracomment>
        <translation>Μικρό</translation>
    </message>
    <message>
        <source>SIZE_L</source>
        <extracomment>A text size. English: “Standard”</extracomment>
        <translation>Κανονικό</translation>
    </message>
    <message>
        <source>SIZE_XL</source>
        <extracomment>A text size. English: “Large”</extracomment>
        <translation>Μεγάλο</translation>
    </message>
    <message>
        <source>SIZE_XXL</source>
        <extracomment>A text size. English: “Larger”</extracomment>
        <translation>Μεγαλύτερο</translation>
    </message>
    <message>
        <source>SIZE_XXXL</source>
        <extracomment>A text size. English: “Largest”</extracomment>
        <translation>Μέγιστο</translation>
    </message>
    <message>
        <source>SIZE_AX</source>
        <extracomment>A text size beyond the largest; %@ is a number from 1 to 5. English: “Very large %@”</extracomment>
        <translation>Πολύ μεγάλο %@</translation>
    </message>
    <message>
        <source>SETTINGS_COLORS</source>
        <extracomment>A setting; its value is one of the following. English: “Colours”</extracomment>
        <translation>Χρώματα</translation>
    </message>
    <message>
        <source>SETTINGS_AS_SYSTEM</source>
        <extracomment>The value of a setting that follows the desktop. English: “As the system”</extracomment>
        <translation>Όπως το σύστημα</translation>
    </message>
    <message>
        <source>COLORS_LIGHT</source>
        <extracomment>Of the colours. English: “Light”</extracomment>
        <translation>Φωτεινά</translation>
    </message>
    <message>
        <source>COLORS_DARK</source>
        <extracomment>Of the colours. English: “Dark”</extracomment>
        <translation>Σκούρα</translation>
    </message>
    <message>
        <source>COLORS_HIGH</source>
        <extracomment>Of the colours. English: “High contrast”</extracomment>
        <translation>Υψηλή αντίθεση</translation>
    </message>
    <message>
        <source>SETTINGS_DISTANCES</source>
        <extracomment>A setting; its value is one of the following. English: “Distances”</extracomment>
        <translation>Αποστάσεις</translation>
    </message>
    <message>
        <source>DISTANCES_METRIC</source>
        <extracomment>Of the distances. English: “Kilometres”</extracomment>
        <translation>Χιλιόμετρα</translation>
    </message>
    <message>
        <source>DISTANCES_MILES</source>
        <extracomment>Of the distances. English: “Miles”</extracomment>
        <translation>Μίλια</translation>
    </message>
    <message>
        <source>SETTINGS_LANGUAGE</source>
        <extracomment>A setting; its value is the name of a language. English: “Language”</extracomment>
        <translation>Γλώσσα</translation>
    </message>
    <message>
        <source>SETTINGS_CONTACTS</source>
        <extracomment>The name of a section: what this computer adds to answers. English: “Contacts and position”</extracomment>
        <translation>Επαφές και θέση</translation>
    </message>
    <message>
        <source>SETTINGS_BOOKS</source>
        <extracomment>A switch: the desktop’s address books. English: “Address books”</extracomment>
        <translation>Βιβλία διευθύνσεων</translation>
    </message>
    <message>
        <source>SETTINGS_BOOKS_LINE</source>
        <extracomment>Under that switch. English: “Names and faces come from them.”</extracomment>
        <translation>Από εκεί έρχονται ονόματα και πρόσωπα.</translation>
    </message>
    <message>
        <source>SETTINGS_POSITION</source>
        <extracomment>A switch: where the user’s computer is. English: “My position”</extracomment>
        <translation>Η θέση μου</translation>
    </message>
    <message>
        <source>SETTINGS_POSITION_LINE</source>
        <extracomment>Under that switch. English: “Distances are counted from it.”</extracomment>
        <translation>Από εκεί μετριούνται οι αποστάσεις.</translation>
    </message>
    <message>
        <source>SETTINGS_WATCH</source>
        <extracomment>A switch on the page with settings: notifications of friends who come and go</extracomment>
        <translation>Ειδοποιήσεις</translation>
    </message>
    <message>
        <source>SETTINGS_WATCH_LINE</source>
        <extracomment>Under that switch</extracomment>
        <translation>Όταν φίλοι φεύγουν ή φτάνουν, όπως ζητήσατε.</translation>
    </message>
    <message>
        <source>SETTINGS_WATCH_NONE</source>
        <extracomment>Under that switch, in the place of its line, where the computer cannot run anything in the background</extracomment>
        <translation>Εδώ τίποτα δεν μπορεί να εκτελείται στο παρασκήνιο.</translation>
    </message>
    <message>
        <source>SETTINGS_MAPS</source>
        <extracomment>The name of a section. English: “Maps”</extracomment>
        <translation>Χάρτες</translation>
    </message>
    <message>
        <source>MAPS_WORLD</source>
        <extracomment>A map that is always there. English: “The world”</extracomment>
        <translation>Ο κόσμος</translation>
    </message>
    <message>
        <source>MAPS_WORLD_LINE</source>
        <extracomment>Under its name. English: “Towns, borders and large roads”</extracomment>
        <translation>Πόλεις, σύνορα και μεγάλοι δρόμοι</translation>
    </message>
    <message>
        <source>MAPS_STREETS</source>
        <extracomment>Under the name of a map with streets; %@ is the size of its file, such as “12 MB”. English: “Streets, %@”</extracomment>
        <translation>Δρόμοι, %@</translation>
    </message>
    <message>
        <source>MAPS_ADD</source>
        <extracomment>Opens a dialog that chooses a file with a map. English: “Add a region”</extracomment>
        <translation>Προσθήκη περιοχής</translation>
    </message>
    <message>
        <source>MAPS_REMOVE</source>
        <extracomment>A button: the map is not drawn any more. English: “Remove this map”</extracomment>
        <translation>Αφαίρεση αυτού του χάρτη</translation>
    </message>
    <message>
        <source>MAPS_REFUSED</source>
        <extracomment>Said when a chosen file is no map. English: “This file isn’t a map that can be drawn.”</extracomment>
        <translation>Αυτό το αρχείο δεν είναι χάρτης που σχεδιάζεται.</translation>
    </message>
    <message>
        <source>SETTINGS_HELP</source>
        <extracomment>The name of a section. English: “Help”</extracomment>
        <translation>Βοήθεια</translation>
    </message>
    <message>
        <source>SETTINGS_SET_FOR_YOU</source>
        <extracomment>Under a setting that an administrator or the command line holds. English: “Set for you”</extracomment>
        <translation>Ορίστηκε για εσάς</translation>
    </message>
    <message>
        <source>STATUS_TRY_NOW</source>
        <extracomment>A button at the end of the status line while the service cannot be reached. English: “Try now”</extracomment>
        <translation>Δοκιμή τώρα</translation>
    </message>
    <message>
        <source>PAGE_FRIENDS_SHARE</source>
        <extracomment>On the page with the list of friends: a section with those who let the user see where they are. English: “They share with you”</extracomment>
        <translation>Μοιράζονται μαζί σας</translation>
    </message>
    <message>
        <source>SIGN_IN_HAVE_LINK</source>
        <extracomment>A button on the page for signing in: asks for a link instead. English: “I have a link”</extracomment>
        <translation>Έχω σύνδεσμο</translation>
    </message>
    <message>
        <source>SIGN_IN_USE_SECRET</source>
        <extracomment>A button there: asks for address, person and secret again. English: “Use address and secret”</extracomment>
        <translation>Χρήση διεύθυνσης και μυστικού</translation>
    </message>
    <message>
        <source>SIGN_IN_LINK</source>
        <extracomment>Label of a field: a link that signs in. English: “Link”</extracomment>
        <translation>Σύνδεσμος</translation>
    </message>
    <message>
        <source>SIGN_IN_LINK_LINE</source>
        <extracomment>Below the title, above that field. English: “Paste the link you were given. It works once.”</extracomment>
        <translation>Επικολλήστε τον σύνδεσμο που σας δόθηκε. Ισχύει μία φορά.</translation>
    </message>
    <message>
        <source>SIGN_IN_LINK_SPENT</source>
        <extracomment>Below the link; the service does not tell which of the two it is. English: “This link was used, or is too old. Ask for a new one.”</extracomment>
        <translation>Ο σύνδεσμος χρησιμοποιήθηκε ή πάλιωσε. Ζητήστε νέον.</translation>
    </message>
    <message>
        <source>SIGN_IN_BAD_LINK</source>
        <extracomment>Below the link. English: “This isn’t a link for signing in.”</extracomment>
        <translation>Αυτός δεν είναι σύνδεσμος για σύνδεση.</translation>
    </message>
    <message>
        <source>SIGN_IN_ALREADY</source>
        <extracomment>Said when a link that signs in comes while somebody is signed in. English: “You are signed in. Sign out first to use this link.”</extracomment>
        <translation>Είστε συνδεδεμένοι. Αποσυνδεθείτε πρώτα για να χρησιμοποιήσετε τον σύνδεσμο.</translation>
    </message>
    <message>
        <source>CHECK_UP</source>
        <extracomment>The name of the page that says what is wrong and what mends it. English: “Check-up”</extracomment>
        <translation>Έλεγχος</translation>
    </message>
    <message>
        <source>CHECK_WELL</source>
        <extracomment>Title of that page when nothing is wrong. English: “All is well.”</extracomment>
        <translation>Όλα είναι καλά.</translation>
    </message>
    <message>
        <source>CHECK_NOW</source>
        <extracomment>Below that title. English: “Checked just now.”</extracomment>
        <translation>Ελέγχθηκε μόλις τώρα.</translation>
    </message>
    <message>
        <source>CHECK_REST</source>
        <extracomment>Below the title when something is wrong. English: “Everything else is fine. Checked just now.”</extracomment>
        <translation>Όλα τα άλλα είναι καλά. Ελέγχθηκε μόλις τώρα.</translation>
    </message>
    <message>
        <source>CHECK_HANDS</source>
        <extracomment>Title when something is wrong; %@ is how many things. English: “{0, plural, one{One thing needs a hand.} other{%@ things need a hand.}}”</extracomment>
        <translation>{0, plural, one{Ένα πράγμα θέλει ένα χέρι.} other{%@ πράγματα θέλουν ένα χέρι.}}</translation>
    </message>
    <message>
        <source>CHECK_FINE</source>
        <extracomment>The name of the section with what is in order. English: “Fine”</extracomment>
        <translation>Εντάξει</translation>
    </message>
    <message>
        <source>CHECK_AGAIN</source>
        <extracomment>A button. English: “Check again”</extracomment>
        <translation>Νέος έλεγχος</translation>
    </message>
    <message>
        <source>CHECK_REPORT</source>
        <extracomment>A button. English: “Copy report”</extracomment>
        <translation>Αντιγραφή αναφοράς</translation>
    </message>
    <message>
        <source>CHECK_COMMAND</source>
        <extracomment>A button: puts the command that mends a thing into the clipboard, for a terminal. English: “Copy the command”</extracomment>
        <translation>Αντιγραφή εντολής</translation>
    </message>
    <message>
        <source>CHECK_SIGN_IN_AGAIN</source>
        <extracomment>A button. English: “Sign in again”</extracomment>
        <translation>Νέα σύνδεση</translation>
    </message>
    <message>
        <source>CHECK_SET_CLOCK</source>
        <extracomment>A button. English: “Set the clock”</extracomment>
        <translation>Ρύθμιση ρολογιού</translation>
    </message>
    <message>
        <source>CHECK_ASK_AGAIN</source>
        <extracomment>A button: asks the address book again. English: “Ask it again”</extracomment>
        <translation>Νέα ερώτηση</translation>
    </message>
    <message>
        <source>CHECK_ACCOUNT</source>
        <extracomment>A thing that is fine. English: “Account”</extracomment>
        <translation>Λογαριασμός</translation>
    </message>
    <message>
        <source>CHECK_SERVICE</source>
        <extracomment>A thing that is fine. English: “Service”</extracomment>
        <translation>Υπηρεσία</translation>
    </message>
    <message>
        <source>CHECK_CLOCK</source>
        <extracomment>A thing that is fine. English: “Clock”</extracomment>
        <translation>Ρολόι</translation>
    </message>
    <message>
        <source>CHECK_CONTACTS</source>
        <extracomment>A thing that is fine: files with contacts. English: “Contacts”</extracomment>
        <translation>Επαφές</translation>
    </message>
    <message>
        <source>CHECK_LETTERS</source>
        <extracomment>A thing that is fine: fonts for all scripts. English: “Letters”</extracomment>
        <translation>Γράμματα</translation>
    </message>
    <message>
        <source>CHECK_READER</source>
        <extracomment>A thing that is fine. English: “Screen reader”</extracomment>
        <translation>Αναγνώστης οθόνης</translation>
    </message>
    <message>
        <source>CHECK_DESKTOP</source>
        <extracomment>A thing that is fine: what the desktop offers to programs. English: “Desktop”</extracomment>
        <translation>Επιφάνεια εργασίας</translation>
    </message>
    <message>
        <source>CHECK_NOBODY</source>
        <extracomment>A thing that is wrong. English: “Nobody is signed in.”</extracomment>
        <translation>Κανείς δεν είναι συνδεδεμένος.</translation>
    </message>
    <message>
        <source>CHECK_LOCKED</source>
        <extracomment>A thing that is wrong. English: “The keyring is locked.”</extracomment>
        <translation>Η κλειδοθήκη είναι κλειδωμένη.</translation>
    </message>
    <message>
        <source>CHECK_LOCKED_LINE</source>
        <extracomment>Its cause. English: “Your secret can’t be read, so nobody is asked until it is open.”</extracomment>
        <translation>Το μυστικό σας δεν διαβάζεται, και κανείς δεν ερωτάται ώσπου να ανοίξει.</translation>
    </message>
    <message>
        <source>CHECK_UNREACHABLE</source>
        <extracomment>A thing that is wrong. English: “The service can’t be reached.”</extracomment>
        <translation>Η υπηρεσία δεν είναι προσβάσιμη.</translation>
    </message>
    <message>
        <source>CHECK_UNREACHABLE_LINE</source>
        <extracomment>Its cause; %@ is an address. English: “Nothing answers at %@.”</extracomment>
        <translation>Τίποτα δεν απαντά στο %@.</translation>
    </message>
    <message>
        <source>CHECK_REDIRECT_LINE</source>
        <extracomment>Another cause. English: “An address is remembered that isn’t your service’s.”</extracomment>
        <translation>Απομνημονεύεται διεύθυνση που δεν ανήκει στην υπηρεσία σας.</translation>
    </message>
    <message>
        <source>CHECK_UNKNOWN</source>
        <extracomment>A thing that is wrong. English: “The service doesn’t know you any more.”</extracomment>
        <translation>Η υπηρεσία δεν σας γνωρίζει πια.</translation>
    </message>
    <message>
        <source>CHECK_CLOCKS</source>
        <extracomment>A thing that is wrong. English: “The clocks disagree.”</extracomment>
        <translation>Τα ρολόγια διαφωνούν.</translation>
    </message>
    <message>
        <source>CHECK_AHEAD</source>
        <extracomment>Its cause; %@ is a number of minutes. English: “This computer is %@ min ahead of the service, so ages are wrong.”</extracomment>
        <translation>Ο υπολογιστής προηγείται της υπηρεσίας κατά %@ λ., άρα οι ηλικίες είναι λάθος.</translation>
    </message>
    <message>
        <source>CHECK_BEHIND</source>
        <extracomment>Its cause; %@ is a number of minutes. English: “This computer is %@ min behind the service, so ages are wrong.”</extracomment>
        <translation>Ο υπολογιστής υστερεί της υπηρεσίας κατά %@ λ., άρα οι ηλικίες είναι λάθος.</translation>
    </message>
    <message>
        <source>CHECK_BOOKS_SILENT</source>
        <extracomment>A thing that is wrong. English: “Your address book is silent.”</extracomment>
        <translation>Το βιβλίο διευθύνσεων σιωπά.</translation>
    </message>
    <message>
        <source>CHECK_BOOKS_LINE</source>
        <extracomment>Its cause. English: “It hasn’t answered. Names come from the service for now.”</extracomment>
        <translation>Δεν απάντησε. Τα ονόματα έρχονται προς το παρόν από την υπηρεσία.</translation>
    </message>
    <message>
        <source>CHECK_NO_CONTACTS</source>
        <extracomment>A thing that is wrong. English: “Your contacts can’t be read.”</extracomment>
        <translation>Οι επαφές σας δεν διαβάζονται.</translation>
    </message>
    <message>
        <source>CHECK_FILE_LINE</source>
        <extracomment>A cause: of contacts, of a map, of the settings. English: “A file is missing or broken.”</extracomment>
        <translation>Ένα αρχείο λείπει ή είναι χαλασμένο.</translation>
    </message>
    <message>
        <source>CHECK_NOWHERE</source>
        <extracomment>A thing that is wrong. English: “Nobody knows where you are.”</extracomment>
        <translation>Κανείς δεν ξέρει πού είστε.</translation>
    </message>
    <message>
        <source>CHECK_NOWHERE_LINE</source>
        <extracomment>Its cause. English: “This computer has no position, so there are no distances.”</extracomment>
        <translation>Ο υπολογιστής δεν έχει θέση, άρα δεν υπάρχουν αποστάσεις.</translation>
    </message>
    <message>
        <source>CHECK_NO_MAP</source>
        <extracomment>A thing that is wrong. English: “A map can’t be drawn.”</extracomment>
        <translation>Ένας χάρτης δεν σχεδιάζεται.</translation>
    </message>
    <message>
        <source>CHECK_NO_LETTERS</source>
        <extracomment>A thing that is wrong. English: “Letters are missing.”</extracomment>
        <translation>Λείπουν γράμματα.</translation>
    </message>
    <message>
        <source>CHECK_LETTERS_LINE</source>
        <extracomment>Its cause. English: “Some names show as boxes.”</extracomment>
        <translation>Κάποια ονόματα φαίνονται ως κουτάκια.</translation>
    </message>
    <message>
        <source>CHECK_DEAF</source>
        <extracomment>A thing that is wrong. English: “Screen readers can’t listen.”</extracomment>
        <translation>Οι αναγνώστες οθόνης δεν ακούν.</translation>
    </message>
    <message>
        <source>CHECK_DEAF_LINE</source>
        <extracomment>Its cause. English: “What joins them to programs doesn’t answer.”</extracomment>
        <translation>Ό,τι τους συνδέει με τα προγράμματα δεν απαντά.</translation>
    </message>
    <message>
        <source>CHECK_NO_DESKTOP</source>
        <extracomment>A thing that is wrong. English: “The desktop doesn’t answer.”</extracomment>
        <translation>Η επιφάνεια εργασίας δεν απαντά.</translation>
    </message>
    <message>
        <source>CHECK_NO_DESKTOP_LINE</source>
        <extracomment>Its cause. English: “Its colours and contrast aren’t followed, and links may not open.”</extracomment>
        <translation>Τα χρώματα και η αντίθεσή της δεν ακολουθούνται, και ίσως δεν ανοίγουν σύνδεσμοι.</translation>
    </message>
    <message>
        <source>SHARING_REFUSED</source>
        <extracomment>Under that switch, when the service does not do this. English: “Your service can’t change this here.”</extracomment>
        <translation>Η υπηρεσία σας δεν μπορεί να το αλλάξει από εδώ.</translation>
    </message>
</context>
</TS>
