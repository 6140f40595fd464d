<?xml version="1.0" encoding="utf-8"?>
<!DOCTYPE TS>
<TS version="2.1" language="it" sourcelanguage="en">
<context>
    <name>Localizable</name>
    <message>
        <source>VISIBLE_TO</source>
        <extracomment>Title of the people's page; %@ is the number, in words from NUMBERS or in digits. English: “{0, plural, one{%@ person can see where you are.} other{%@ people can see where you are.}}”</extracomment>
        <translation>{0, plural, one{%@ persona può vedere dove sei.} other{%@ persone possono vedere dove sei.}}</translation>
    </message>
    <message>
        <source>NUMBERS</source>
        <extracomment>The numbers from one to twelve as they begin VISIBLE_TO, in its gender and case, with a bar between; a hyphen alone where digits are usual. English: “One|Two|Three|Four|Five|Six|Seven|Eight|Nine|Ten|Eleven|Twelve”</extracomment>
        <translation>Una|Due|Tre|Quattro|Cinque|Sei|Sette|Otto|Nove|Dieci|Undici|Dodici</translation>
    </message>
    <message>
        <source>VISIBLE_TO_NOBODY</source>
        <extracomment>Title of the people's page while the reader hides or shares with nobody. English: “Nobody can see where you are.”</extracomment>
        <translation>Nessuno può vedere dove sei.</translation>
    </message>
    <message>
        <source>VISIBLE</source>
        <extracomment>Label of the one switch over everything. English: “Visible to friends”</extracomment>
        <translation>Visibile agli amici</translation>
    </message>
    <message>
        <source>VISIBLE_ON</source>
        <extracomment>Below VISIBLE while the switch is on. English: “Off hides you from everyone at once.”</extracomment>
        <translation>Spegnendo ti nascondi subito da tutti.</translation>
    </message>
    <message>
        <source>VISIBLE_OFF</source>
        <extracomment>Below VISIBLE while the switch is off. English: “Turn on, and the rules below hold again.”</extracomment>
        <translation>Accendi, e le regole qui sotto valgono di nuovo.</translation>
    </message>
    <message>
        <source>SWITCH_ON</source>
        <extracomment>Spoken: a switch, %@ is its label, is on. English: “%@, on”</extracomment>
        <translation>%@, acceso</translation>
    </message>
    <message>
        <source>SWITCH_OFF</source>
        <extracomment>Spoken: a switch, %@ is its label, is off. English: “%@, off”</extracomment>
        <translation>%@, spento</translation>
    </message>
    <message>
        <source>WHO_SEES_ME</source>
        <extracomment>Heading above the list of people who see the reader. English: “Who sees me”</extracomment>
        <translation>Chi mi vede</translation>
    </message>
    <message>
        <source>EXACTLY</source>
        <extracomment>How exactly somebody is seen. English: “Exactly”</extracomment>
        <translation>Esattamente</translation>
    </message>
    <message>
        <source>WITHIN_1_KM</source>
        <extracomment>How exactly somebody is seen. English: “Within 1 km”</extracomment>
        <translation>Entro 1 km</translation>
    </message>
    <message>
        <source>TOWN</source>
        <extracomment>How exactly somebody is seen. English: “The town”</extracomment>
        <translation>La città</translation>
    </message>
    <message>
        <source>NAMED_PLACES</source>
        <extracomment>How exactly somebody is seen: only when they are at one of their named places. English: “Only places I have named”</extracomment>
        <translation>Solo luoghi a cui ho dato un nome</translation>
    </message>
    <message>
        <source>RULE_ALWAYS</source>
        <extracomment>A rule: %@ is how exactly. English: “%@, always”</extracomment>
        <translation>%@, sempre</translation>
    </message>
    <message>
        <source>RULE_MIDNIGHT</source>
        <extracomment>A rule that ends at the next midnight: %@ is how exactly. English: “%@, until midnight”</extracomment>
        <translation>%@, fino a mezzanotte</translation>
    </message>
    <message>
        <source>RULE_TIME</source>
        <extracomment>A rule that ends: %1$@ is how exactly, %2$@ a time or a day and time. English: “%1$@, until %2$@”</extracomment>
        <translation>%1$@, fino a: %2$@</translation>
    </message>
    <message>
        <source>RULE_PLACE</source>
        <extracomment>A rule that ends when the reader arrives: %1$@ is how exactly, %2$@ the reader's name of a place. English: “%1$@, until you are at %2$@”</extracomment>
        <translation>%1$@, finché non arrivi: %2$@</translation>
    </message>
    <message>
        <source>RULE_ENDED</source>
        <extracomment>In place of a rule that is over: %@ is a day and time. English: “Ended: %@”</extracomment>
        <translation>Finito: %@</translation>
    </message>
    <message>
        <source>RULE_ASKED</source>
        <extracomment>A rule without an end asks now and then whether it is still meant; %@ is the day on which it ends without an answer. English: “Still meant? Without an answer it ends: %@.”</extracomment>
        <translation>Vale ancora? Senza risposta finisce: %@.</translation>
    </message>
    <message>
        <source>KEEP_SHARING</source>
        <extracomment>Button: the rule goes on. English: “Keep sharing”</extracomment>
        <translation>Continua a condividere</translation>
    </message>
    <message>
        <source>SHARE_WITH</source>
        <extracomment>Row or button that begins a new rule. English: “Share with somebody”</extracomment>
        <translation>Condividi con qualcuno</translation>
    </message>
    <message>
        <source>ASKED_TITLE</source>
        <extracomment>Above those who asked the reader to share. English: “Would like to see where you are”</extracomment>
        <translation>Vorrebbero vedere dove sei</translation>
    </message>
    <message>
        <source>ASKED_SHARE</source>
        <extracomment>Button beside somebody who asked: leads to the page of a rule. English: “Share”</extracomment>
        <translation>Condividi</translation>
    </message>
    <message>
        <source>ASKED_NOT_NOW</source>
        <extracomment>Button beside it: the request goes, nobody hears of it. English: “Not now”</extracomment>
        <translation>Non ora</translation>
    </message>
    <message>
        <source>SHARE_WHO</source>
        <extracomment>Label of a field. English: “Name, e-mail address or phone number”</extracomment>
        <translation>Nome, indirizzo e-mail o numero di telefono</translation>
    </message>
    <message>
        <source>SHARE_UNKNOWN</source>
        <extracomment>Nobody was found by what was typed. English: “Nobody here is called so. Whoever runs the service can add people.”</extracomment>
        <translation>Nessuno qui si chiama così. Chi gestisce il servizio può aggiungere persone.</translation>
    </message>
    <message>
        <source>SHARE_SELF</source>
        <extracomment>The reader typed their own name. English: “Nobody shares with themselves.”</extracomment>
        <translation>Nessuno condivide con sé stesso.</translation>
    </message>
    <message>
        <source>GO_ON</source>
        <extracomment>Button: to the next step. English: “Go on”</extracomment>
        <translation>Avanti</translation>
    </message>
    <message>
        <source>WHO_LOOKED</source>
        <extracomment>Heading above the list of people who looked. English: “Who looked”</extracomment>
        <translation>Chi ha guardato</translation>
    </message>
    <message>
        <source>ALL_LOOKS</source>
        <extracomment>Row that opens all that is kept of who looked; %@ is a number of days. English: “{0, plural, one{All of the last day} other{All of the last %@ days}}”</extracomment>
        <translation>{0, plural, one{Tutto l’ultimo giorno} other{Tutto degli ultimi %@ giorni}}</translation>
    </message>
    <message>
        <source>NOBODY_LOOKED</source>
        <extracomment>No entry in the list of people who looked. English: “Nobody has looked.”</extracomment>
        <translation>Nessuno ha guardato.</translation>
    </message>
    <message>
        <source>CARRIED</source>
        <extracomment>After the name of who looked: their phone fetched it by itself, nobody asked. English: “by their phone alone”</extracomment>
        <translation>solo il suo telefono</translation>
    </message>
    <message>
        <source>MY_DATA</source>
        <extracomment>Heading. English: “My phone and my data”</extracomment>
        <translation>Il mio telefono e i miei dati</translation>
    </message>
    <message>
        <source>SET_UP_PHONE</source>
        <extracomment>Row and title. English: “Set up a phone”</extracomment>
        <translation>Configura un telefono</translation>
    </message>
    <message>
        <source>MY_DEVICES</source>
        <extracomment>Row and title: list of phones, programs and browsers. English: “My devices”</extracomment>
        <translation>I miei dispositivi</translation>
    </message>
    <message>
        <source>MY_SETTINGS</source>
        <extracomment>Row and title: language, time zone, how long things are kept. English: “Settings”</extracomment>
        <translation>Impostazioni</translation>
    </message>
    <message>
        <source>GET_COPY</source>
        <extracomment>Row: a file with everything about the reader. English: “Get a copy of my data”</extracomment>
        <translation>Ottieni una copia dei miei dati</translation>
    </message>
    <message>
        <source>DELETE_ALL</source>
        <extracomment>Row and title. English: “Delete everything about me”</extracomment>
        <translation>Elimina tutto su di me</translation>
    </message>
    <message>
        <source>SIGN_OUT</source>
        <extracomment>Button. English: “Sign out”</extracomment>
        <translation>Esci</translation>
    </message>
    <message>
        <source>BACK</source>
        <extracomment>Spoken: the arrow back. English: “Back”</extracomment>
        <translation>Indietro</translation>
    </message>
    <message>
        <source>SEES_TITLE</source>
        <extracomment>Title of the page about one rule; %@ is a name. English: “What %@ sees”</extracomment>
        <translation>Che cosa vede %@</translation>
    </message>
    <message>
        <source>SEES_THIS</source>
        <extracomment>Below a row that shows the reader as %@ sees them. English: “%@ sees you exactly like this.”</extracomment>
        <translation>%@ ti vede esattamente così.</translation>
    </message>
    <message>
        <source>SEES_NOTHING</source>
        <extracomment>In place of that row; %@ is a name. English: “%@ sees no place of yours now.”</extracomment>
        <translation>%@ ora non vede nessun tuo luogo.</translation>
    </message>
    <message>
        <source>A_PLACE_WITHIN</source>
        <extracomment>In that row: a place that is known within a distance, %@. English: “Within %@”</extracomment>
        <translation>Entro %@</translation>
    </message>
    <message>
        <source>HOW_EXACTLY</source>
        <extracomment>Heading above a choice. English: “How exactly”</extracomment>
        <translation>Quanto esattamente</translation>
    </message>
    <message>
        <source>UNTIL</source>
        <extracomment>Heading above a choice. English: “Until”</extracomment>
        <translation>Fino a</translation>
    </message>
    <message>
        <source>UNTIL_CHANGED</source>
        <extracomment>Choice of when a rule ends: not by itself. English: “I change it”</extracomment>
        <translation>Quando lo cambio io</translation>
    </message>
    <message>
        <source>UNTIL_MIDNIGHT</source>
        <extracomment>Choice of when a rule ends. English: “Midnight”</extracomment>
        <translation>Mezzanotte</translation>
    </message>
    <message>
        <source>UNTIL_ARRIVAL</source>
        <extracomment>Choice of when a rule ends; a list of places follows. English: “I arrive at”</extracomment>
        <translation>Quando arrivo:</translation>
    </message>
    <message>
        <source>UNTIL_TIME</source>
        <extracomment>Choice of when a rule ends; a field for a time follows. English: “A time”</extracomment>
        <translation>Un’ora</translation>
    </message>
    <message>
        <source>SAID_ALOUD</source>
        <extracomment>Label of a box to tick: speakers may say where the reader is. English: “May be said aloud”</extracomment>
        <translation>Si può dire ad alta voce</translation>
    </message>
    <message>
        <source>SAID_ALOUD_WHERE</source>
        <extracomment>Below SAID_ALOUD; %@ is a name. English: “Speakers at %@’s may say it”</extracomment>
        <translation>Gli altoparlanti da %@ possono dirlo</translation>
    </message>
    <message>
        <source>SAVE</source>
        <extracomment>Button. English: “Save”</extracomment>
        <translation>Salva</translation>
    </message>
    <message>
        <source>STOP</source>
        <extracomment>Button and title; %@ is a name. English: “Stop sharing with %@”</extracomment>
        <translation>Non condividere più con %@</translation>
    </message>
    <message>
        <source>STOP_ASK</source>
        <extracomment>Asks before STOP; %@ is a name. English: “%@ will see nothing of you from now on. What their phone has shown stays on it.”</extracomment>
        <translation>%@ non vedrà più nulla di te. Ciò che il suo telefono ha mostrato vi resta.</translation>
    </message>
    <message>
        <source>KEEP</source>
        <extracomment>Button: do not stop, do not delete. English: “Keep”</extracomment>
        <translation>Mantieni</translation>
    </message>
    <message>
        <source>STEP_INSTALL</source>
        <extracomment>First step of setting up a phone. English: “Install a tracker app that can send to an address of your own.”</extracomment>
        <translation>Installa un’app di tracciamento che possa inviare a un indirizzo tuo.</translation>
    </message>
    <message>
        <source>STEP_TYPE</source>
        <extracomment>Second step; three values follow. English: “Type these three into it.”</extracomment>
        <translation>Scrivi in essa questi tre valori.</translation>
    </message>
    <message>
        <source>STEP_RUN</source>
        <extracomment>Third step. English: “Let it run, then look again: the phone’s first place shows up here.”</extracomment>
        <translation>Lasciala andare, poi guarda di nuovo: il primo luogo del telefono appare qui.</translation>
    </message>
    <message>
        <source>ADDRESS</source>
        <extracomment>Label of a value to type. English: “Address”</extracomment>
        <translation>Indirizzo</translation>
    </message>
    <message>
        <source>USER</source>
        <extracomment>Label of a value to type. English: “User”</extracomment>
        <translation>Utente</translation>
    </message>
    <message>
        <source>PASSWORD</source>
        <extracomment>Label of a value to type. English: “Password”</extracomment>
        <translation>Password</translation>
    </message>
    <message>
        <source>SHOWN_ONCE</source>
        <extracomment>Warning below the values. English: “This password is shown once. For another phone, set up another.”</extracomment>
        <translation>Questa password viene mostrata una volta sola. Per un altro telefono, configurane un’altra.</translation>
    </message>
    <message>
        <source>WAS_SHOWN</source>
        <extracomment>In place of the password; %@ is a day. English: “Shown once: %@.”</extracomment>
        <translation>Mostrata una volta: %@.</translation>
    </message>
    <message>
        <source>ADDRESS_ALONE</source>
        <extracomment>Above an address for apps that take nothing else. English: “For apps that take nothing but an address:”</extracomment>
        <translation>Per le app che accettano solo un indirizzo:</translation>
    </message>
    <message>
        <source>MAKE_PASSWORD</source>
        <extracomment>Button on the first page of setting up a phone. English: “Show what to type”</extracomment>
        <translation>Mostra che cosa scrivere</translation>
    </message>
    <message>
        <source>NOTHING_YET</source>
        <extracomment>No message of a phone has come. English: “Nothing has come yet.”</extracomment>
        <translation>Non è ancora arrivato nulla.</translation>
    </message>
    <message>
        <source>HERE_SINCE</source>
        <extracomment>A phone's first place has come; %1$@ is a time, %2$@ a distance. English: “Here since %1$@, within about %2$@.”</extracomment>
        <translation>Qui da %1$@, entro circa %2$@.</translation>
    </message>
    <message>
        <source>HERE_SINCE_TIME</source>
        <extracomment>A phone was heard; %@ is a time. English: “Here since %@.”</extracomment>
        <translation>Qui da %@.</translation>
    </message>
    <message>
        <source>LOOK_AGAIN</source>
        <extracomment>Button: loads the page again. English: “Look again”</extracomment>
        <translation>Guarda di nuovo</translation>
    </message>
    <message>
        <source>OTHER_PHONE</source>
        <extracomment>Above a code for a camera. English: “Is the phone another one than this? Point its camera here, and this page opens on it.”</extracomment>
        <translation>Il telefono è un altro? Punta qui la sua fotocamera, e questa pagina si apre lì.</translation>
    </message>
    <message>
        <source>CODE</source>
        <extracomment>Spoken: a picture with a code for a camera. English: “Code for a camera”</extracomment>
        <translation>Codice per una fotocamera</translation>
    </message>
    <message>
        <source>DEVICE_PHONE</source>
        <extracomment>A device of the reader's. English: “Phone”</extracomment>
        <translation>Telefono</translation>
    </message>
    <message>
        <source>DEVICE_READER</source>
        <extracomment>A device of the reader's: the program that shows friends. English: “Program that asks for friends”</extracomment>
        <translation>Programma che chiede degli amici</translation>
    </message>
    <message>
        <source>DEVICE_BROWSER</source>
        <extracomment>A device of the reader's. English: “Browser”</extracomment>
        <translation>Browser</translation>
    </message>
    <message>
        <source>DEVICE_THIS</source>
        <extracomment>A device of the reader's: the one in use. English: “This browser”</extracomment>
        <translation>Questo browser</translation>
    </message>
    <message>
        <source>DEVICE_HEARD</source>
        <extracomment>Below a device; %@ is a day and time. English: “Last heard: %@”</extracomment>
        <translation>Ultimo segnale: %@</translation>
    </message>
    <message>
        <source>DEVICE_SINCE</source>
        <extracomment>Below a device; %@ is a day and time. English: “Since: %@”</extracomment>
        <translation>Da: %@</translation>
    </message>
    <message>
        <source>DEVICE_END</source>
        <extracomment>Button: the device may do nothing any more. English: “End”</extracomment>
        <translation>Termina</translation>
    </message>
    <message>
        <source>DEVICE_END_SPOKEN</source>
        <extracomment>Spoken: the same button; %@ is the device and its day. English: “End: %@”</extracomment>
        <translation>Termina: %@</translation>
    </message>
    <message>
        <source>DEVICE_ASK</source>
        <extracomment>Asks before DEVICE_END. English: “It sends nothing and sees nobody from then on, and what it began ends.”</extracomment>
        <translation>Non invia più nulla e non vede più nessuno, e ciò che ha iniziato finisce.</translation>
    </message>
    <message>
        <source>SETTINGS_PLACES_KEPT</source>
        <extracomment>Label of a choice of durations. English: “My places are kept for”</extracomment>
        <translation>I miei luoghi vengono tenuti</translation>
    </message>
    <message>
        <source>SETTINGS_LOOKS_KEPT</source>
        <extracomment>Label of a choice of durations. English: “Who looked is kept for”</extracomment>
        <translation>Chi ha guardato viene tenuto</translation>
    </message>
    <message>
        <source>SETTINGS_ZONE</source>
        <extracomment>Label of a choice. English: “Time zone”</extracomment>
        <translation>Fuso orario</translation>
    </message>
    <message>
        <source>SETTINGS_LANGUAGE</source>
        <extracomment>Label of a choice. English: “Language”</extracomment>
        <translation>Lingua</translation>
    </message>
    <message>
        <source>SAVED</source>
        <extracomment>After saving. English: “Saved.”</extracomment>
        <translation>Salvato.</translation>
    </message>
    <message>
        <source>DELETE_ASK</source>
        <extracomment>Asks before everything about the reader is deleted. English: “Your places, rules, devices and the notes of who looked go for good. Phones of friends keep what they have shown.”</extracomment>
        <translation>I tuoi luoghi, le regole, i dispositivi e le note su chi ha guardato spariscono per sempre. I telefoni degli amici tengono ciò che hanno mostrato.</translation>
    </message>
    <message>
        <source>DELETE_NOW</source>
        <extracomment>Button. English: “Delete everything”</extracomment>
        <translation>Elimina tutto</translation>
    </message>
    <message>
        <source>DELETED</source>
        <extracomment>After everything was deleted. English: “Everything about you is deleted.”</extracomment>
        <translation>Tutto su di te è eliminato.</translation>
    </message>
    <message>
        <source>LINK_TITLE</source>
        <extracomment>Title of the page that a link opens. English: “Your own page”</extracomment>
        <translation>La tua pagina</translation>
    </message>
    <message>
        <source>LINK_TEXT</source>
        <extracomment>Below it. English: “This link works once. After that this browser stays signed in for 30 days.”</extracomment>
        <translation>Questo link vale una volta. Poi questo browser resta connesso per 30 giorni.</translation>
    </message>
    <message>
        <source>LINK_OPEN</source>
        <extracomment>Button. English: “Open my page”</extracomment>
        <translation>Apri la mia pagina</translation>
    </message>
    <message>
        <source>LINK_SPENT</source>
        <extracomment>The link cannot be used any more. English: “This link has been used, or its 15 minutes are over. Ask for another one.”</extracomment>
        <translation>Questo link è stato usato, o i suoi 15 minuti sono passati. Chiedine un altro.</translation>
    </message>
    <message>
        <source>SIGNED_OUT</source>
        <extracomment>Title: nobody is signed in. English: “This page opens with a link.”</extracomment>
        <translation>Questa pagina si apre con un link.</translation>
    </message>
    <message>
        <source>SIGNED_OUT_TEXT</source>
        <extracomment>Below it. English: “Whoever runs the service gives you one. It works once, for 15 minutes.”</extracomment>
        <translation>Chi gestisce il servizio te ne dà uno. Vale una volta, per 15 minuti.</translation>
    </message>
    <message>
        <source>NO_SUCH_PAGE</source>
        <extracomment>Title. English: “There is no such page.”</extracomment>
        <translation>Questa pagina non esiste.</translation>
    </message>
    <message>
        <source>NOT_FROM_HERE</source>
        <extracomment>A form that another page sent. English: “This did not come from your own page. Nothing has changed.”</extracomment>
        <translation>Questo non veniva dalla tua pagina. Non è cambiato nulla.</translation>
    </message>
    <message>
        <source>NOT_KEPT</source>
        <extracomment>The service could not write. English: “It could not be kept just now. Nothing has changed; try again in a while.”</extracomment>
        <translation>Ora non si è potuto salvare. Non è cambiato nulla; riprova tra un po’.</translation>
    </message>
    <message>
        <source>NOT_UNDERSTOOD</source>
        <extracomment>A form with something missing. English: “Something is missing there. Nothing has changed; go back and choose again.”</extracomment>
        <translation>Manca qualcosa. Non è cambiato nulla; torna indietro e scegli di nuovo.</translation>
    </message>
    <message>
        <source>TIME_WANTED</source>
        <extracomment>No time was given beside the choice of one. English: “Choose the time at which it ends.”</extracomment>
        <translation>Scegli l’ora a cui finisce.</translation>
    </message>
    <message>
        <source>TO_MY_PAGE</source>
        <extracomment>Link. English: “To my page”</extracomment>
        <translation>Alla mia pagina</translation>
    </message>
    <message>
        <source>MY_PLACES</source>
        <extracomment>Row and title: places to which the reader gave names. English: “My places”</extracomment>
        <translation>I miei luoghi</translation>
    </message>
    <message>
        <source>PLACE_NONE</source>
        <extracomment>No place has a name. English: “No place has a name yet.”</extracomment>
        <translation>Nessun luogo ha ancora un nome.</translation>
    </message>
    <message>
        <source>PLACE_HERE</source>
        <extracomment>Heading and button. English: “Name the place where I am”</extracomment>
        <translation>Dai un nome al luogo dove sono</translation>
    </message>
    <message>
        <source>PLACE_HERE_HINT</source>
        <extracomment>Below PLACE_HERE. English: “The place of your phone’s last message, and 150 metres around it.”</extracomment>
        <translation>Il luogo dell’ultimo messaggio del tuo telefono, e 150 metri attorno.</translation>
    </message>
    <message>
        <source>PLACE_NO_FIX</source>
        <extracomment>Instead of PLACE_HERE_HINT. English: “Your phone has sent no place yet.”</extracomment>
        <translation>Il tuo telefono non ha ancora inviato nessun luogo.</translation>
    </message>
    <message>
        <source>PLACE_NAME</source>
        <extracomment>Label of a field. English: “Name of the place”</extracomment>
        <translation>Nome del luogo</translation>
    </message>
    <message>
        <source>PLACE_SAID</source>
        <extracomment>Label of a box to tick, and below a place. English: “Friends may hear its name”</extracomment>
        <translation>Gli amici possono sentirne il nome</translation>
    </message>
    <message>
        <source>PLACE_UNSAID</source>
        <extracomment>Below a place. English: “Nobody hears its name”</extracomment>
        <translation>Nessuno ne sente il nome</translation>
    </message>
    <message>
        <source>PLACE_REMOVE</source>
        <extracomment>Button. English: “Remove”</extracomment>
        <translation>Rimuovi</translation>
    </message>
    <message>
        <source>PLACE_REMOVE_ONE</source>
        <extracomment>Title, and spoken: the same button; %@ is the name of a place. English: “Remove: %@”</extracomment>
        <translation>Rimuovi: %@</translation>
    </message>
    <message>
        <source>PLACE_REMOVE_ASK</source>
        <extracomment>Asks before PLACE_REMOVE. English: “Its name goes, and rules that were to end there end now.”</extracomment>
        <translation>Il nome sparisce, e le regole che dovevano finire lì finiscono ora.</translation>
    </message>
    <message>
        <source>TOLD_MAY</source>
        <extracomment>Label of a switch: whether one person may be told when the reader comes and goes. English: “May be told when you come and go”</extracomment>
        <translation>Può sapere quando arrivi e te ne vai</translation>
    </message>
    <message>
        <source>TOLD_MAY_HINT</source>
        <extracomment>Below TOLD_MAY; %@ is EXACTLY, a choice on the same page. English: “Holds only with “%@”.”</extracomment>
        <translation>Vale solo con «%@».</translation>
    </message>
    <message>
        <source>TOLD_TITLE</source>
        <extracomment>Title of the page that lists who is told when the reader comes and goes, and the way there. English: “Who is told when I come and go”</extracomment>
        <translation>Chi sa quando arrivo e me ne vado</translation>
    </message>
    <message>
        <source>TOLD_NOBODY</source>
        <extracomment>On the page TOLD_TITLE when the list is empty. English: “Nobody is told.”</extracomment>
        <translation>Nessuno lo sa.</translation>
    </message>
    <message>
        <source>TOLD_LEAVING</source>
        <extracomment>In a row with somebody's name: that person is told when the reader leaves %@, a place. English: “When I leave: %@”</extracomment>
        <translation>Quando me ne vado: %@</translation>
    </message>
    <message>
        <source>TOLD_ARRIVING</source>
        <extracomment>In a row with somebody's name: that person is told when the reader arrives at %@, a place. English: “When I arrive: %@”</extracomment>
        <translation>Quando arrivo: %@</translation>
    </message>
    <message>
        <source>PLACE_CHANGE</source>
        <extracomment>Button beside a place of the reader’s own: opens a page that changes it. English: “Change”</extracomment>
        <translation>Modifica</translation>
    </message>
    <message>
        <source>PLACE_CHANGE_ONE</source>
        <extracomment>Title of that page, and the spoken name of that button; %@ is the place’s name. English: “Change %@”</extracomment>
        <translation>Modifica %@</translation>
    </message>
    <message>
        <source>PLACE_KIND</source>
        <extracomment>Label of a choice: what kind of place it is; below it PLACE_KIND_NONE, PLACE_KIND_HOME and so on. English: “Kind”</extracomment>
        <translation>Tipo</translation>
    </message>
    <message>
        <source>PLACE_KIND_NONE</source>
        <extracomment>In the choice PLACE_KIND: no kind. English: “None”</extracomment>
        <translation>Nessuno</translation>
    </message>
    <message>
        <source>PLACE_KIND_HOME</source>
        <extracomment>In the choice PLACE_KIND. English: “Home”</extracomment>
        <translation>Casa</translation>
    </message>
    <message>
        <source>PLACE_KIND_WORK</source>
        <extracomment>In the choice PLACE_KIND. English: “Work”</extracomment>
        <translation>Lavoro</translation>
    </message>
    <message>
        <source>PLACE_KIND_SCHOOL</source>
        <extracomment>In the choice PLACE_KIND. English: “School”</extracomment>
        <translation>Scuola</translation>
    </message>
    <message>
        <source>PLACE_KIND_GYM</source>
        <extracomment>In the choice PLACE_KIND. English: “Gym”</extracomment>
        <translation>Palestra</translation>
    </message>
    <message>
        <source>PLACE_KIND_OTHER</source>
        <extracomment>In the choice PLACE_KIND. English: “Other”</extracomment>
        <translation>Altro luogo</translation>
    </message>
    <message>
        <source>PLACE_TAKEN</source>
        <extracomment>Complaint when a place is given a name that another one has. English: “Another place of yours has this name.”</extracomment>
        <translation>Un altro dei tuoi luoghi ha già questo nome.</translation>
    </message>
    <message>
        <source>NEAR_TOWN</source>
        <extracomment>Where somebody is: %1$@ is the nearest town in the nominative, %2$@ how far away it is (“40 km”). English: “near %1$@, %2$@”</extracomment>
        <translation>vicino a %1$@, %2$@</translation>
    </message>
    <message>
        <source>STREET_IN_TOWN</source>
        <extracomment>Where somebody is: %1$@ is a street, %2$@ its town; change their order where the language does. English: “%1$@, %2$@”</extracomment>
        <translation>%1$@, %2$@</translation>
    </message>
    <message>
        <source>COORDINATES</source>
        <extracomment>Where somebody is, where nothing has a name: %1$@ is DEGREES_NORTH or DEGREES_SOUTH, %2$@ DEGREES_EAST or DEGREES_WEST. English: “%1$@, %2$@”</extracomment>
        <translation>%1$@, %2$@</translation>
    </message>
    <message>
        <source>DEGREES_NORTH</source>
        <extracomment>A latitude; %@ is a number with two decimals. English: “%@° north”</extracomment>
        <translation>%@° nord</translation>
    </message>
    <message>
        <source>DEGREES_SOUTH</source>
        <extracomment>A latitude; %@ is a number with two decimals. English: “%@° south”</extracomment>
        <translation>%@° sud</translation>
    </message>
    <message>
        <source>DEGREES_EAST</source>
        <extracomment>A longitude; %@ is a number with two decimals. English: “%@° east”</extracomment>
        <translation>%@° est</translation>
    </message>
    <message>
        <source>DEGREES_WEST</source>
        <extracomment>A longitude; %@ is a number with two decimals. English: “%@° west”</extracomment>
        <translation>%@° ovest</translation>
    </message>
    <message>
        <source>LINK_COMPUTER</source>
        <extracomment>A button: makes a link with which the program on a computer signs in; and the title of the page that shows it. English: “Sign in on a computer”</extracomment>
        <translation>Accedi su un computer</translation>
    </message>
    <message>
        <source>LINK_COMPUTER_TEXT</source>
        <extracomment>Above the link. English: “Paste this link into ktr on the computer. It works once, within 15 minutes.”</extracomment>
        <translation>Incolla questo link in ktr sul computer. Vale una volta, entro 15 minuti.</translation>
    </message>
</context>
</TS>
