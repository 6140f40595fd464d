<?xml version="1.0" encoding="utf-8"?>
<!DOCTYPE TS>
<TS version="2.1" language="es" sourcelanguage="en">
<context>
    <name>Localizable</name>
    <message>
        <source>TODAY</source>
        <extracomment>Above a question; %@ is the time of day. English: “Today, %@”</extracomment>
        <translation>Hoy, %@</translation>
    </message>
    <message>
        <source>DISTANCE_TEXT</source>
        <extracomment>A frame around each distance (%@, with its unit), for a language that needs one; usually %@ alone. English: “%@”</extracomment>
        <translation>%@</translation>
    </message>
    <message>
        <source>_$!&lt;home&gt;!$_</source>
        <extracomment>A built-in name for a place. English: “Home”</extracomment>
        <translation>Casa</translation>
    </message>
    <message>
        <source>_$!&lt;work&gt;!$_</source>
        <extracomment>A built-in name for a place. English: “Work”</extracomment>
        <translation>Trabajo</translation>
    </message>
    <message>
        <source>_$!&lt;school&gt;!$_</source>
        <extracomment>A built-in name for a place. English: “School”</extracomment>
        <translation>Escuela</translation>
    </message>
    <message>
        <source>_$!&lt;gym&gt;!$_</source>
        <extracomment>A built-in name for a place. English: “Gym”</extracomment>
        <translation>Gimnasio</translation>
    </message>
    <message>
        <source>_$!&lt;other&gt;!$_</source>
        <extracomment>A built-in name for a place. English: “Other”</extracomment>
        <translation>Otro lugar</translation>
    </message>
    <message>
        <source>ASK_FIELD</source>
        <extracomment>What stands in the empty field, and its name for a screen reader. English: “Ask about your friends”</extracomment>
        <translation>Pregunta por tus amigos</translation>
    </message>
    <message>
        <source>ASK_SEND</source>
        <extracomment>The button that sends the question. English: “Send”</extracomment>
        <translation>Enviar</translation>
    </message>
    <message>
        <source>QUESTION_TOO_LONG</source>
        <extracomment>In place of an answer, where what was typed or pasted is too long to be a question</extracomment>
        <translation>Es demasiado largo para una pregunta. Haz una más corta.</translation>
    </message>
    <message>
        <source>ASK_STOP</source>
        <extracomment>The same button, while an answer is waited for: it gives the question up. English: “Stop asking”</extracomment>
        <translation>Dejar de preguntar</translation>
    </message>
    <message>
        <source>ASKING_SLOW</source>
        <extracomment>In the answer’s place, when it takes more than four seconds. English: “Taking longer than usual…”</extracomment>
        <translation>Tarda más de lo habitual…</translation>
    </message>
    <message>
        <source>STATUS_LIVE_NOW</source>
        <extracomment>Status line: answers keep coming. English: “Live · updated just now”</extracomment>
        <translation>En directo · actualizado ahora mismo</translation>
    </message>
    <message>
        <source>STATUS_LIVE_SECONDS</source>
        <extracomment>The same; %@ is a number of seconds. English: “Live · updated %@ s ago”</extracomment>
        <translation>En directo · actualizado hace %@ s</translation>
    </message>
    <message>
        <source>STATUS_LIVE_MINUTES</source>
        <extracomment>The same; %@ is a number of minutes. English: “Live · updated %@ min ago”</extracomment>
        <translation>En directo · actualizado hace %@ min</translation>
    </message>
    <message>
        <source>STATUS_LIVE_HOURS</source>
        <extracomment>The same; %@ is a number of hours. English: “Live · updated %@ h ago”</extracomment>
        <translation>En directo · actualizado hace %@ h</translation>
    </message>
    <message>
        <source>STATUS_PAUSED_NOW</source>
        <extracomment>Status line: no more answers come by themselves. English: “Paused · updated just now”</extracomment>
        <translation>En pausa · actualizado ahora mismo</translation>
    </message>
    <message>
        <source>STATUS_PAUSED_SECONDS</source>
        <extracomment>The same; %@ is a number of seconds. English: “Paused · updated %@ s ago”</extracomment>
        <translation>En pausa · actualizado hace %@ s</translation>
    </message>
    <message>
        <source>STATUS_PAUSED_MINUTES</source>
        <extracomment>The same; %@ is a number of minutes. English: “Paused · updated %@ min ago”</extracomment>
        <translation>En pausa · actualizado hace %@ min</translation>
    </message>
    <message>
        <source>STATUS_PAUSED_HOURS</source>
        <extracomment>The same; %@ is a number of hours. English: “Paused · updated %@ h ago”</extracomment>
        <translation>En pausa · actualizado hace %@ h</translation>
    </message>
    <message>
        <source>STATUS_FINDING_YOU</source>
        <extracomment>Status line: the user's own position is looked for. English: “Finding where you are…”</extracomment>
        <translation>Buscando tu ubicación…</translation>
    </message>
    <message>
        <source>STATUS_HIDDEN</source>
        <extracomment>The status line while friends cannot see where the user is. English: “Your location is hidden”</extracomment>
        <translation>Tu ubicación está oculta</translation>
    </message>
    <message>
        <source>STATUS_ASKING</source>
        <extracomment>Status line: a question waits for its answer. English: “Asking…”</extracomment>
        <translation>Preguntando…</translation>
    </message>
    <message>
        <source>STATUS_OFFLINE</source>
        <extracomment>Status line: the service cannot be reached, and nothing is on screen. English: “Offline.”</extracomment>
        <translation>Sin conexión.</translation>
    </message>
    <message>
        <source>STATUS_OFFLINE_SINCE</source>
        <extracomment>The same with an answer on screen; %@ is the time of day when it was known. English: “Offline. Showing what was known at %@.”</extracomment>
        <translation>Sin conexión. Últimos datos conocidos: %@.</translation>
    </message>
    <message>
        <source>STATUS_FAULTY</source>
        <extracomment>Status line: the service answers, but with an error, or not in its own words; nothing is on screen. English: “Service error.”</extracomment>
        <translation>Error del servicio.</translation>
    </message>
    <message>
        <source>STATUS_FAULTY_SINCE</source>
        <extracomment>The same with an answer on screen; %@ is the time of day when it was known. English: “Service error. Showing what was known at %@.”</extracomment>
        <translation>Error del servicio. Últimos datos conocidos: %@.</translation>
    </message>
    <message>
        <source>STATUS_UNTRUSTED</source>
        <extracomment>Status line: whoever answers cannot prove to be the service; nothing is on screen. English: “Service not trusted.”</extracomment>
        <translation>Servicio no fiable.</translation>
    </message>
    <message>
        <source>STATUS_UNTRUSTED_SINCE</source>
        <extracomment>The same with an answer on screen; %@ is the time of day when it was known. English: “Service not trusted. Showing what was known at %@.”</extracomment>
        <translation>Servicio no fiable. Últimos datos conocidos: %@.</translation>
    </message>
    <message>
        <source>STATUS_SIGN_IN</source>
        <extracomment>Status line: the service does not take the account's credentials, or there is no account. English: “Sign in again to see your friends.”</extracomment>
        <translation>Vuelve a iniciar sesión para ver a tus amigos.</translation>
    </message>
    <message>
        <source>STATUS_SIGN_IN_FIRST</source>
        <extracomment>Status line: nobody has signed in on this computer yet</extracomment>
        <translation>Inicia sesión para ver a tus amigos.</translation>
    </message>
    <message>
        <source>SIGN_IN_TITLE</source>
        <extracomment>Title of the page for signing in</extracomment>
        <translation>¿Dónde están tus amigos?</translation>
    </message>
    <message>
        <source>SIGN_IN_LINE</source>
        <extracomment>Below that title</extracomment>
        <translation>Inicia sesión en el servicio donde compartís lugares. Puede ser el tuyo.</translation>
    </message>
    <message>
        <source>SIGN_IN_ADDRESS</source>
        <extracomment>Label of a field: the address of the service</extracomment>
        <translation>Dirección del servicio</translation>
    </message>
    <message>
        <source>SIGN_IN_YOU</source>
        <extracomment>Label of a field: who signs in</extracomment>
        <translation>Tú</translation>
    </message>
    <message>
        <source>SIGN_IN_SECRET</source>
        <extracomment>Label of a field: the password</extracomment>
        <translation>Secreto</translation>
    </message>
    <message>
        <source>SIGN_IN_GO</source>
        <extracomment>Button: signs in</extracomment>
        <translation>Iniciar sesión</translation>
    </message>
    <message>
        <source>SIGN_IN_CHECKING</source>
        <extracomment>On that button while the service is asked</extracomment>
        <translation>Comprobando…</translation>
    </message>
    <message>
        <source>SIGN_IN_CANCEL</source>
        <extracomment>Button: ends the asking</extracomment>
        <translation>Cancelar</translation>
    </message>
    <message>
        <source>SIGN_IN_RETRY</source>
        <extracomment>Button: asks again after nothing answered</extracomment>
        <translation>Intentar de nuevo</translation>
    </message>
    <message>
        <source>SIGN_IN_SHOW</source>
        <extracomment>Spoken: a button that shows the letters of the secret</extracomment>
        <translation>Mostrar el secreto</translation>
    </message>
    <message>
        <source>SIGN_IN_HIDE</source>
        <extracomment>Spoken: a button that hides them again</extracomment>
        <translation>Ocultar el secreto</translation>
    </message>
    <message>
        <source>SIGN_IN_KEYRING</source>
        <extracomment>Small, below the fields</extracomment>
        <translation>Tu secreto se queda en el llavero de este equipo.</translation>
    </message>
    <message>
        <source>SIGN_IN_UNKNOWN</source>
        <extracomment>Below the secret; does not tell which of the two is wrong</extracomment>
        <translation>El servicio no conoce a esta persona con este secreto. Revisa ambos o pide un secreto nuevo.</translation>
    </message>
    <message>
        <source>SIGN_IN_NOTHING_ANSWERS</source>
        <extracomment>Below the address, which is %@</extracomment>
        <translation>Nada responde en %@. Revisa la dirección y que este equipo tenga conexión.</translation>
    </message>
    <message>
        <source>SIGN_IN_NOT_TRUSTED</source>
        <extracomment>Below the address, which is %@: its certificate is not valid</extracomment>
        <translation>Lo que responde en %@ no puede demostrar que es tu servicio, así que no se envió nada.</translation>
    </message>
    <message>
        <source>SIGN_IN_NO_SERVICE</source>
        <extracomment>Below the address, which is %@: it is some other web server</extracomment>
        <translation>En %@ responde otra cosa. Revisa la dirección.</translation>
    </message>
    <message>
        <source>SIGN_IN_FAILING</source>
        <extracomment>Below the address, which is %@: the service reports a failure of its own</extracomment>
        <translation>%@ no puede ayudar ahora mismo.</translation>
    </message>
    <message>
        <source>SIGN_IN_BAD_ADDRESS</source>
        <extracomment>Below the address; keep brin.example as it is</extracomment>
        <translation>Una dirección tiene esta forma: brin.example.</translation>
    </message>
    <message>
        <source>SIGN_IN_LOCKED</source>
        <extracomment>The system's keyring is locked or missing</extracomment>
        <translation>El llavero está cerrado. Desbloquéalo o guarda tu secreto en un archivo que solo tú puedas leer.</translation>
    </message>
    <message>
        <source>SIGN_IN_UNLOCK</source>
        <extracomment>Button: tries the keyring again</extracomment>
        <translation>Desbloquear el llavero</translation>
    </message>
    <message>
        <source>SIGN_IN_IN_FILE</source>
        <extracomment>Button: keeps the secret in a file instead of the keyring</extracomment>
        <translation>Guardar en un archivo</translation>
    </message>
    <message>
        <source>SIGN_IN_NOT_WRITTEN</source>
        <extracomment>The configuration cannot be written</extracomment>
        <translation>Tus ajustes no se pueden guardar en este equipo.</translation>
    </message>
    <message>
        <source>GREETING_MORNING</source>
        <extracomment>Title of an empty conversation</extracomment>
        <translation>Buenos días.</translation>
    </message>
    <message>
        <source>GREETING_AFTERNOON</source>
        <extracomment>Title of an empty conversation</extracomment>
        <translation>Buenas tardes.</translation>
    </message>
    <message>
        <source>GREETING_EVENING</source>
        <extracomment>Title of an empty conversation</extracomment>
        <translation>Buenas noches.</translation>
    </message>
    <message>
        <source>GREETING_LINE</source>
        <extracomment>Below that title</extracomment>
        <translation>Pregunta por tus amigos o toca una pregunta.</translation>
    </message>
    <message>
        <source>SUGGEST_FRIENDS</source>
        <extracomment>A question that is asked by a tap</extracomment>
        <translation>¿Dónde están mis amigos?</translation>
    </message>
    <message>
        <source>SUGGEST_NEAR</source>
        <extracomment>A question that is asked by a tap</extracomment>
        <translation>¿Quién está cerca de mí?</translation>
    </message>
    <message>
        <source>SUGGEST_HIDE</source>
        <extracomment>A wish that is asked for by a tap</extracomment>
        <translation>Ocultar mi ubicación</translation>
    </message>
    <message>
        <source>ANSWER_UNREACHABLE</source>
        <extracomment>Below a question that nobody answered. English: “Your assistant is out of reach right now.”</extracomment>
        <translation>No se puede acceder a tu asistente en este momento.</translation>
    </message>
    <message>
        <source>ANSWER_SIGN_IN</source>
        <extracomment>Below a question that was asked without an account. English: “Sign in to ask about your friends.”</extracomment>
        <translation>Inicia sesión para preguntar por tus amigos.</translation>
    </message>
    <message>
        <source>ANSWER_NOT_SHOWN</source>
        <extracomment>Below a question whose answer is of a kind that cannot be shown. English: “This answer cannot be shown here.”</extracomment>
        <translation>Esta respuesta no se puede mostrar aquí.</translation>
    </message>
    <message>
        <source>ANSWER_RESTRICTED</source>
        <extracomment>Below a question, while the device allows no friends’ locations. English: “Friends’ locations are switched off on this device.”</extracomment>
        <translation>Las ubicaciones de amigos están desactivadas en este dispositivo.</translation>
    </message>
    <message>
        <source>STATUS_UNREADABLE</source>
        <extracomment>Status line: the configuration is broken. English: “Your settings cannot be read.”</extracomment>
        <translation>No se pueden leer tus ajustes.</translation>
    </message>
    <message>
        <source>MAP_NOT_AVAILABLE</source>
        <extracomment>In place of a map that nobody can draw. English: “Map not available”</extracomment>
        <translation>Mapa no disponible</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_LINK</source>
        <extracomment>What a screen reader would say, written down: %@ can be opened. English: “%@ (link)”</extracomment>
        <translation>%@ (enlace)</translation>
    </message>
    <message>
        <source>ACCESSIBILITY_IMAGE</source>
        <extracomment>The same: %@ describes a picture. English: “%@ (image)”</extracomment>
        <translation>%@ (imagen)</translation>
    </message>
    <message>
        <source>ANNOUNCE_QUESTION</source>
        <extracomment>A screen reader’s name for what the user asked. English: “Question”</extracomment>
        <translation>Pregunta</translation>
    </message>
    <message>
        <source>ANNOUNCE_ANSWER</source>
        <extracomment>A screen reader’s name for the sentence that answers. English: “Answer”</extracomment>
        <translation>Respuesta</translation>
    </message>
    <message>
        <source>ANNOUNCE_PEOPLE</source>
        <extracomment>Said after the sentence of an answer that has come: %@ is how many people are on it. English: “People: %@.”</extracomment>
        <translation>Personas: %@.</translation>
    </message>
    <message>
        <source>ANNOUNCE_PLACE</source>
        <extracomment>Said when a friend (%1$@) has come to another place (%2$@, such as “Fish Market”, “Home” or “Brinmouth, HB”). English: “%1$@: %2$@.”</extracomment>
        <translation>%1$@: %2$@.</translation>
    </message>
    <message>
        <source>ANNOUNCE_UNSEEN</source>
        <extracomment>Said when the place of a friend (%@) is not told any more. English: “%@ is no longer visible.”</extracomment>
        <translation>La ubicación de %@ ya no se ve.</translation>
    </message>
    <message>
        <source>ANNOUNCE_SEEN</source>
        <extracomment>Said when the place (%2$@) of a friend (%1$@) is known again. English: “%1$@ is visible again: %2$@.”</extracomment>
        <translation>La ubicación de %1$@ se ve de nuevo: %2$@.</translation>
    </message>
    <message>
        <source>ANNOUNCE_SEEN_SOMEWHERE</source>
        <extracomment>The same for a place without a name. English: “%@ is visible again.”</extracomment>
        <translation>La ubicación de %@ se ve de nuevo.</translation>
    </message>
    <message>
        <source>ANNOUNCE_UNREACHABLE</source>
        <extracomment>Said when the friends’ service cannot be reached any more. English: “Your friends are out of reach. What is shown may be old.”</extracomment>
        <translation>No se puede contactar con tus amigos. Lo que se muestra puede ser antiguo.</translation>
    </message>
    <message>
        <source>ANNOUNCE_REACHABLE</source>
        <extracomment>Said when it can be reached again. English: “Your friends are within reach again.”</extracomment>
        <translation>Se puede contactar de nuevo con tus amigos.</translation>
    </message>
    <message>
        <source>ANNOUNCE_NEXT</source>
        <extracomment>Two sentences that are said one after the other, as the language parts them; each has its full stop. English: “%1$@ %2$@”</extracomment>
        <translation>%1$@ %2$@</translation>
    </message>
    <message>
        <source>LINK_NOBODY</source>
        <extracomment>A tap on a link that no program opens</extracomment>
        <translation>Ningún programa de este equipo abre enlaces.</translation>
    </message>
    <message>
        <source>PLACE_NOBODY</source>
        <extracomment>The same, of a place on the map</extracomment>
        <translation>Ningún programa de este equipo abre lugares.</translation>
    </message>
    <message>
        <source>CALL_NOBODY</source>
        <extracomment>The same, of a call</extracomment>
        <translation>Ningún programa de este equipo hace llamadas.</translation>
    </message>
    <message>
        <source>WRITE_NOBODY</source>
        <extracomment>The same, of a message</extracomment>
        <translation>Ningún programa de este equipo escribe mensajes.</translation>
    </message>
    <message>
        <source>LINK_REFUSED</source>
        <extracomment>A link of a kind that this program does not open</extracomment>
        <translation>Este enlace no se abre aquí.</translation>
    </message>
    <message>
        <source>LINK_UNKNOWN</source>
        <extracomment>A link from elsewhere about nobody who is among the user’s friends</extracomment>
        <translation>No sé de quién trata este enlace.</translation>
    </message>
    <message>
        <source>FRIEND_CALL</source>
        <extracomment>Under a round button: calls the friend</extracomment>
        <translation>Llamar</translation>
    </message>
    <message>
        <source>FRIEND_WRITE</source>
        <extracomment>Under a round button: writes to the friend</extracomment>
        <translation>Escribir</translation>
    </message>
    <message>
        <source>FRIEND_MAPS</source>
        <extracomment>Under a round button: opens the place in a program for maps</extracomment>
        <translation>Abrir en mapas</translation>
    </message>
    <message>
        <source>FRIEND_COPY</source>
        <extracomment>Under a round button: puts the place into the clipboard</extracomment>
        <translation>Copiar lugar</translation>
    </message>
    <message>
        <source>FRIEND_COPIED</source>
        <extracomment>In the place of “Copy place”, for two seconds after it was pressed</extracomment>
        <translation>Copiado</translation>
    </message>
    <message>
        <source>FRIEND_SHOW</source>
        <extracomment>A button: brings the friend (%@) back into view on the map</extracomment>
        <translation>Mostrar a %@</translation>
    </message>
    <message>
        <source>FRIEND_WHERE</source>
        <extracomment>A button that asks where a friend (%@) is</extracomment>
        <translation>¿Dónde está %@?</translation>
    </message>
    <message>
        <source>FRIEND_NOT_SEEN</source>
        <extracomment>A friend (%@) whose place is not to be seen</extracomment>
        <translation>No puedo ver dónde está %@.</translation>
    </message>
    <message>
        <source>MAP_CLOSER</source>
        <extracomment>A button on the map, spoken: zooms in</extracomment>
        <translation>Más cerca</translation>
    </message>
    <message>
        <source>MAP_FURTHER</source>
        <extracomment>A button on the map, spoken: zooms out</extracomment>
        <translation>Más lejos</translation>
    </message>
    <message>
        <source>MAP_SPOKEN</source>
        <extracomment>The map of a friend’s page, spoken; %@ is the friend</extracomment>
        <translation>Mapa alrededor de %@</translation>
    </message>
    <message>
        <source>HOW_FEW</source>
        <extracomment>How exactly a place is known: up to 15 metres</extracomment>
        <translation>A unos pocos metros</translation>
    </message>
    <message>
        <source>HOW_WITHIN</source>
        <extracomment>The same; %@ is a distance with its unit</extracomment>
        <translation>A unos %@</translation>
    </message>
    <message>
        <source>HOW_NEAR</source>
        <extracomment>The same, of a wide place; %@ is a distance with its unit</extracomment>
        <translation>En algún lugar cercano, a unos %@</translation>
    </message>
    <message>
        <source>PAGE_FRIENDS</source>
        <extracomment>The name of the page with the list of friends</extracomment>
        <translation>Amigos</translation>
    </message>
    <message>
        <source>PAGE_FRIENDS_NONE</source>
        <extracomment>On that page, when nobody was asked about</extracomment>
        <translation>Aún no se ha preguntado por nadie.</translation>
    </message>
    <message>
        <source>PAGE_ME</source>
        <extracomment>The name of the user’s own page</extracomment>
        <translation>Mi ubicación</translation>
    </message>
    <message>
        <source>SHARING_SWITCH</source>
        <extracomment>A switch on that page</extracomment>
        <translation>Los amigos pueden verme</translation>
    </message>
    <message>
        <source>SHARING_ON</source>
        <extracomment>Under that switch, while it is on</extracomment>
        <translation>Quienes tú permites pueden ver dónde estás.</translation>
    </message>
    <message>
        <source>SHARING_OFF</source>
        <extracomment>Under that switch, while it is off</extracomment>
        <translation>Nadie puede ver dónde estás.</translation>
    </message>
    <message>
        <source>SHARING_UNKNOWN</source>
        <extracomment>Under that switch, while the service has not been told anything by it</extracomment>
        <translation>Tu servicio aún no lo ha dicho.</translation>
    </message>
    <message>
        <source>SHARING_FAILED</source>
        <extracomment>Under that switch, when the wish did not reach the service</extracomment>
        <translation>Tu servicio no respondió. Aquí nada ha cambiado.</translation>
    </message>
    <message>
        <source>MAP_NO_STREETS</source>
        <extracomment>Under a card whose map has no streets</extracomment>
        <translation>Aún no hay calles de esta región.</translation>
    </message>
    <message>
        <source>MAP_GET_STREETS</source>
        <extracomment>Beside it, a button: chooses a file with a map</extracomment>
        <translation>Obtener calles</translation>
    </message>
    <message>
        <source>MAP_NO_PLACE</source>
        <extracomment>On the plain ground of a map whose friend has no place</extracomment>
        <translation>Ningún lugar</translation>
    </message>
    <message>
        <source>MENU_CUT</source>
        <extracomment>In the menu of the field</extracomment>
        <translation>Cortar</translation>
    </message>
    <message>
        <source>MENU_COPY</source>
        <extracomment>In the menu of the field and of the conversation</extracomment>
        <translation>Copiar</translation>
    </message>
    <message>
        <source>MENU_PASTE</source>
        <extracomment>In the menu of the field</extracomment>
        <translation>Pegar</translation>
    </message>
    <message>
        <source>MENU_SELECT_ALL</source>
        <extracomment>In the menu of the field</extracomment>
        <translation>Seleccionar todo</translation>
    </message>
    <message>
        <source>WATCH_ARRIVAL</source>
        <extracomment>A notification about a friend, below the name: the friend has arrived at %@, a place with a name, or a time such as 17:42. English: “Arrived: %@”</extracomment>
        <translation>Llegada: %@</translation>
    </message>
    <message>
        <source>WATCH_DEPARTURE</source>
        <extracomment>A notification about a friend, below the name: the friend has left %@, a place with a name, or a time such as 17:42. English: “Left: %@”</extracomment>
        <translation>Salida: %@</translation>
    </message>
    <message>
        <source>WATCH_SOMEBODY_ARRIVED</source>
        <extracomment>A notification while the screen is locked: it says neither who nor where. English: “Somebody arrived”</extracomment>
        <translation>Alguien ha llegado</translation>
    </message>
    <message>
        <source>WATCH_SOMEBODY_LEFT</source>
        <extracomment>A notification while the screen is locked: it says neither who nor where. English: “Somebody left”</extracomment>
        <translation>Alguien se ha ido</translation>
        <source>PAGE_BACK</source>
        <extracomment>The way back from a page, spoken</extracomment>
        <translation>Atrás</translation>
    </message>
    <message>
        <source>SETTINGS</source>
        <extracomment>The name of the page with the user’s settings, and spoken of the button that opens it. English: “Settings”</extracomment>
        <translation>Ajustes</translation>
    </message>
    <message>
        <source>SETTINGS_SIGN_OUT</source>
        <extracomment>A button on that page. English: “Sign out”</extracomment>
        <translation>Cerrar sesión</translation>
    </message>
    <message>
        <source>SETTINGS_SHARING</source>
        <extracomment>The name of a section of that page. English: “Sharing”</extracomment>
        <translation>Compartir</translation>
    </message>
    <message>
        <source>SETTINGS_WHO</source>
        <extracomment>Leads to the service’s own page in a browser. English: “Who sees what”</extracomment>
        <translation>Quién ve qué</translation>
    </message>
    <message>
        <source>SETTINGS_READING</source>
        <extracomment>The name of a section. English: “Reading”</extracomment>
        <translation>Lectura</translation>
    </message>
    <message>
        <source>SETTINGS_TEXT_SIZE</source>
        <extracomment>A setting; its value is one of the sizes below. English: “Text size”</extracomment>
        <translation>Tamaño del texto</translation>
    </message>
    <message>
        <source>SETTINGS_SMALLER</source>
        <extracomment>Spoken: a button beside it. English: “Smaller text”</extracomment>
        <translation>Texto más pequeño</translation>
    </message>
    <message>
        <source>SETTINGS_LARGER</source>
        <extracomment>Spoken: a button beside it. English: “Larger text”</extracomment>
        <translation>Texto más grande</translation>
    </message>
    <message>
        <source>SIZE_XS</source>
        <extracomment>A text size. English: “Smallest”</extracomment>
        <translation>El menor</translation>
    </message>
    <message>
        <source>SIZE_S</source>
        <extracomment>A text size. English: “Smaller”</extracomment>
        <translation>Menor</translation>
    </message>
    <message>
        <source>SIZE_M</source>
        <extracomment>A text size. English: “Small”</extracomment>
        <translation>Pequeño</translation>
    </message>
    <message>
        <source>SIZE_L</source>
        <extracomment>A text size. English: “Standard”</extracomment>
        <translation>Normal</translation>
    </message>
    <message>
        <source>SIZE_XL</source>
        <extracomment>A text size. English: “Large”</extracomment>
        <translation>Grande</translation>
    </message>
    <message>
        <source>SIZE_XXL</source>
        <extracomment>A text size. English: “Larger”</extracomment>
        <translation>Mayor</translation>
    </message>
    <message>
        <source>SIZE_XXXL</source>
        <extracomment>A text size. English: “Largest”</extracomment>
        <translation>El mayor</translation>
    </message>
    <message>
        <source>SIZE_AX</source>
        <extracomment>A text size beyond the largest; %@ is a number from 1 to 5. English: “Very large %@”</extracomment>
        <translation>Muy grande %@</translation>
    </message>
    <message>
        <source>SETTINGS_COLORS</source>
        <extracomment>A setting; its value is one of the following. English: “Colours”</extracomment>
        <translation>Colores</translation>
    </message>
    <message>
        <source>SETTINGS_AS_SYSTEM</source>
        <extracomment>The value of a setting that follows the desktop. English: “As the system”</extracomment>
        <translation>Como el sistema</translation>
    </message>
    <message>
        <source>COLORS_LIGHT</source>
        <extracomment>Of the colours. English: “Light”</extracomment>
        <translation>Claros</translation>
    </message>
    <message>
        <source>COLORS_DARK</source>
        <extracomment>Of the colours. English: “Dark”</extracomment>
        <translation>Oscuros</translation>
    </message>
    <message>
        <source>COLORS_HIGH</source>
        <extracomment>Of the colours. English: “High contrast”</extracomment>
        <translation>Alto contraste</translation>
    </message>
    <message>
        <source>SETTINGS_DISTANCES</source>
        <extracomment>A setting; its value is one of the following. English: “Distances”</extracomment>
        <translation>Distancias</translation>
    </message>
    <message>
        <source>DISTANCES_METRIC</source>
        <extracomment>Of the distances. English: “Kilometres”</extracomment>
        <translation>Kilómetros</translation>
    </message>
    <message>
        <source>DISTANCES_MILES</source>
        <extracomment>Of the distances. English: “Miles”</extracomment>
        <translation>Millas</translation>
    </message>
    <message>
        <source>SETTINGS_LANGUAGE</source>
        <extracomment>A setting; its value is the name of a language. English: “Language”</extracomment>
        <translation>Idioma</translation>
    </message>
    <message>
        <source>SETTINGS_CONTACTS</source>
        <extracomment>The name of a section: what this computer adds to answers. English: “Contacts and position”</extracomment>
        <translation>Contactos y posición</translation>
    </message>
    <message>
        <source>SETTINGS_BOOKS</source>
        <extracomment>A switch: the desktop’s address books. English: “Address books”</extracomment>
        <translation>Libretas de direcciones</translation>
    </message>
    <message>
        <source>SETTINGS_BOOKS_LINE</source>
        <extracomment>Under that switch. English: “Names and faces come from them.”</extracomment>
        <translation>De ahí vienen nombres y caras.</translation>
    </message>
    <message>
        <source>SETTINGS_POSITION</source>
        <extracomment>A switch: where the user’s computer is. English: “My position”</extracomment>
        <translation>Mi posición</translation>
    </message>
    <message>
        <source>SETTINGS_POSITION_LINE</source>
        <extracomment>Under that switch. English: “Distances are counted from it.”</extracomment>
        <translation>Desde ahí se cuentan las distancias.</translation>
    </message>
    <message>
        <source>SETTINGS_WATCH</source>
        <extracomment>A switch on the page with settings: notifications of friends who come and go</extracomment>
        <translation>Notificaciones</translation>
    </message>
    <message>
        <source>SETTINGS_WATCH_LINE</source>
        <extracomment>Under that switch</extracomment>
        <translation>Cuando tus amigos salen o llegan, como pediste.</translation>
    </message>
    <message>
        <source>SETTINGS_WATCH_NONE</source>
        <extracomment>Under that switch, in the place of its line, where the computer cannot run anything in the background</extracomment>
        <translation>Aquí nada puede funcionar en segundo plano.</translation>
    </message>
    <message>
        <source>SETTINGS_MAPS</source>
        <extracomment>The name of a section. English: “Maps”</extracomment>
        <translation>Mapas</translation>
    </message>
    <message>
        <source>MAPS_WORLD</source>
        <extracomment>A map that is always there. English: “The world”</extracomment>
        <translation>El mundo</translation>
    </message>
    <message>
        <source>MAPS_WORLD_LINE</source>
        <extracomment>Under its name. English: “Towns, borders and large roads”</extracomment>
        <translation>Ciudades, fronteras y carreteras grandes</translation>
    </message>
    <message>
        <source>MAPS_STREETS</source>
        <extracomment>Under the name of a map with streets; %@ is the size of its file, such as “12 MB”. English: “Streets, %@”</extracomment>
        <translation>Calles, %@</translation>
    </message>
    <message>
        <source>MAPS_ADD</source>
        <extracomment>Opens a dialog that chooses a file with a map. English: “Add a region”</extracomment>
        <translation>Añadir una región</translation>
    </message>
    <message>
        <source>MAPS_REMOVE</source>
        <extracomment>A button: the map is not drawn any more. English: “Remove this map”</extracomment>
        <translation>Quitar este mapa</translation>
    </message>
    <message>
        <source>MAPS_REFUSED</source>
        <extracomment>Said when a chosen file is no map. English: “This file isn’t a map that can be drawn.”</extracomment>
        <translation>Este archivo no es un mapa que se pueda dibujar.</translation>
    </message>
    <message>
        <source>SETTINGS_HELP</source>
        <extracomment>The name of a section. English: “Help”</extracomment>
        <translation>Ayuda</translation>
    </message>
    <message>
        <source>SETTINGS_SET_FOR_YOU</source>
        <extracomment>Under a setting that an administrator or the command line holds. English: “Set for you”</extracomment>
        <translation>Fijado para ti</translation>
    </message>
    <message>
        <source>STATUS_TRY_NOW</source>
        <extracomment>A button at the end of the status line while the service cannot be reached. English: “Try now”</extracomment>
        <translation>Probar ahora</translation>
    </message>
    <message>
        <source>PAGE_FRIENDS_SHARE</source>
        <extracomment>On the page with the list of friends: a section with those who let the user see where they are. English: “They share with you”</extracomment>
        <translation>Comparten contigo</translation>
    </message>
    <message>
        <source>SIGN_IN_HAVE_LINK</source>
        <extracomment>A button on the page for signing in: asks for a link instead. English: “I have a link”</extracomment>
        <translation>Tengo un enlace</translation>
    </message>
    <message>
        <source>SIGN_IN_USE_SECRET</source>
        <extracomment>A button there: asks for address, person and secret again. English: “Use address and secret”</extracomment>
        <translation>Usar dirección y secreto</translation>
    </message>
    <message>
        <source>SIGN_IN_LINK</source>
        <extracomment>Label of a field: a link that signs in. English: “Link”</extracomment>
        <translation>Enlace</translation>
    </message>
    <message>
        <source>SIGN_IN_LINK_LINE</source>
        <extracomment>Below the title, above that field. English: “Paste the link you were given. It works once.”</extracomment>
        <translation>Pega el enlace que te dieron. Sirve una vez.</translation>
    </message>
    <message>
        <source>SIGN_IN_LINK_SPENT</source>
        <extracomment>Below the link; the service does not tell which of the two it is. English: “This link was used, or is too old. Ask for a new one.”</extracomment>
        <translation>Este enlace ya se usó o es demasiado viejo. Pide otro.</translation>
    </message>
    <message>
        <source>SIGN_IN_BAD_LINK</source>
        <extracomment>Below the link. English: “This isn’t a link for signing in.”</extracomment>
        <translation>Este no es un enlace para iniciar sesión.</translation>
    </message>
    <message>
        <source>SIGN_IN_ALREADY</source>
        <extracomment>Said when a link that signs in comes while somebody is signed in. English: “You are signed in. Sign out first to use this link.”</extracomment>
        <translation>Ya has iniciado sesión. Ciérrala primero para usar este enlace.</translation>
    </message>
    <message>
        <source>CHECK_UP</source>
        <extracomment>The name of the page that says what is wrong and what mends it. English: “Check-up”</extracomment>
        <translation>Revisión</translation>
    </message>
    <message>
        <source>CHECK_WELL</source>
        <extracomment>Title of that page when nothing is wrong. English: “All is well.”</extracomment>
        <translation>Todo está bien.</translation>
    </message>
    <message>
        <source>CHECK_NOW</source>
        <extracomment>Below that title. English: “Checked just now.”</extracomment>
        <translation>Revisado ahora mismo.</translation>
    </message>
    <message>
        <source>CHECK_REST</source>
        <extracomment>Below the title when something is wrong. English: “Everything else is fine. Checked just now.”</extracomment>
        <translation>Lo demás está bien. Revisado ahora mismo.</translation>
    </message>
    <message>
        <source>CHECK_HANDS</source>
        <extracomment>Title when something is wrong; %@ is how many things. English: “{0, plural, one{One thing needs a hand.} other{%@ things need a hand.}}”</extracomment>
        <translation>{0, plural, one{Una cosa necesita ayuda.} other{%@ cosas necesitan ayuda.}}</translation>
    </message>
    <message>
        <source>CHECK_FINE</source>
        <extracomment>The name of the section with what is in order. English: “Fine”</extracomment>
        <translation>Bien</translation>
    </message>
    <message>
        <source>CHECK_AGAIN</source>
        <extracomment>A button. English: “Check again”</extracomment>
        <translation>Revisar de nuevo</translation>
    </message>
    <message>
        <source>CHECK_REPORT</source>
        <extracomment>A button. English: “Copy report”</extracomment>
        <translation>Copiar informe</translation>
    </message>
    <message>
        <source>CHECK_COMMAND</source>
        <extracomment>A button: puts the command that mends a thing into the clipboard, for a terminal. English: “Copy the command”</extracomment>
        <translation>Copiar la orden</translation>
    </message>
    <message>
        <source>CHECK_SIGN_IN_AGAIN</source>
        <extracomment>A button. English: “Sign in again”</extracomment>
        <translation>Iniciar sesión de nuevo</translation>
    </message>
    <message>
        <source>CHECK_SET_CLOCK</source>
        <extracomment>A button. English: “Set the clock”</extracomment>
        <translation>Poner en hora</translation>
    </message>
    <message>
        <source>CHECK_ASK_AGAIN</source>
        <extracomment>A button: asks the address book again. English: “Ask it again”</extracomment>
        <translation>Preguntar de nuevo</translation>
    </message>
    <message>
        <source>CHECK_ACCOUNT</source>
        <extracomment>A thing that is fine. English: “Account”</extracomment>
        <translation>Cuenta</translation>
    </message>
    <message>
        <source>CHECK_SERVICE</source>
        <extracomment>A thing that is fine. English: “Service”</extracomment>
        <translation>Servicio</translation>
    </message>
    <message>
        <source>CHECK_CLOCK</source>
        <extracomment>A thing that is fine. English: “Clock”</extracomment>
        <translation>Reloj</translation>
    </message>
    <message>
        <source>CHECK_CONTACTS</source>
        <extracomment>A thing that is fine: files with contacts. English: “Contacts”</extracomment>
        <translation>Contactos</translation>
    </message>
    <message>
        <source>CHECK_LETTERS</source>
        <extracomment>A thing that is fine: fonts for all scripts. English: “Letters”</extracomment>
        <translation>Letras</translation>
    </message>
    <message>
        <source>CHECK_READER</source>
        <extracomment>A thing that is fine. English: “Screen reader”</extracomment>
        <translation>Lector de pantalla</translation>
    </message>
    <message>
        <source>CHECK_DESKTOP</source>
        <extracomment>A thing that is fine: what the desktop offers to programs. English: “Desktop”</extracomment>
        <translation>Escritorio</translation>
    </message>
    <message>
        <source>CHECK_NOBODY</source>
        <extracomment>A thing that is wrong. English: “Nobody is signed in.”</extracomment>
        <translation>Nadie ha iniciado sesión.</translation>
    </message>
    <message>
        <source>CHECK_LOCKED</source>
        <extracomment>A thing that is wrong. English: “The keyring is locked.”</extracomment>
        <translation>El llavero está bloqueado.</translation>
    </message>
    <message>
        <source>CHECK_LOCKED_LINE</source>
        <extracomment>Its cause. English: “Your secret can’t be read, so nobody is asked until it is open.”</extracomment>
        <translation>No se puede leer tu secreto, así que no se pregunta a nadie hasta que se abra.</translation>
    </message>
    <message>
        <source>CHECK_UNREACHABLE</source>
        <extracomment>A thing that is wrong. English: “The service can’t be reached.”</extracomment>
        <translation>No se puede llegar al servicio.</translation>
    </message>
    <message>
        <source>CHECK_UNREACHABLE_LINE</source>
        <extracomment>Its cause; %@ is an address. English: “Nothing answers at %@.”</extracomment>
        <translation>Nada responde en %@.</translation>
    </message>
    <message>
        <source>CHECK_REDIRECT_LINE</source>
        <extracomment>Another cause. English: “An address is remembered that isn’t your service’s.”</extracomment>
        <translation>Se recuerda una dirección que no es de tu servicio.</translation>
    </message>
    <message>
        <source>CHECK_UNKNOWN</source>
        <extracomment>A thing that is wrong. English: “The service doesn’t know you any more.”</extracomment>
        <translation>El servicio ya no te conoce.</translation>
    </message>
    <message>
        <source>CHECK_CLOCKS</source>
        <extracomment>A thing that is wrong. English: “The clocks disagree.”</extracomment>
        <translation>Los relojes no coinciden.</translation>
    </message>
    <message>
        <source>CHECK_AHEAD</source>
        <extracomment>Its cause; %@ is a number of minutes. English: “This computer is %@ min ahead of the service, so ages are wrong.”</extracomment>
        <translation>Este equipo va %@ min por delante del servicio, así que las antigüedades fallan.</translation>
    </message>
    <message>
        <source>CHECK_BEHIND</source>
        <extracomment>Its cause; %@ is a number of minutes. English: “This computer is %@ min behind the service, so ages are wrong.”</extracomment>
        <translation>Este equipo va %@ min por detrás del servicio, así que las antigüedades fallan.</translation>
    </message>
    <message>
        <source>CHECK_BOOKS_SILENT</source>
        <extracomment>A thing that is wrong. English: “Your address book is silent.”</extracomment>
        <translation>Tu libreta de direcciones calla.</translation>
    </message>
    <message>
        <source>CHECK_BOOKS_LINE</source>
        <extracomment>Its cause. English: “It hasn’t answered. Names come from the service for now.”</extracomment>
        <translation>No ha respondido. Por ahora los nombres vienen del servicio.</translation>
    </message>
    <message>
        <source>CHECK_NO_CONTACTS</source>
        <extracomment>A thing that is wrong. English: “Your contacts can’t be read.”</extracomment>
        <translation>No se pueden leer tus contactos.</translation>
    </message>
    <message>
        <source>CHECK_FILE_LINE</source>
        <extracomment>A cause: of contacts, of a map, of the settings. English: “A file is missing or broken.”</extracomment>
        <translation>Falta un archivo o está dañado.</translation>
    </message>
    <message>
        <source>CHECK_NOWHERE</source>
        <extracomment>A thing that is wrong. English: “Nobody knows where you are.”</extracomment>
        <translation>Nadie sabe dónde estás.</translation>
    </message>
    <message>
        <source>CHECK_NOWHERE_LINE</source>
        <extracomment>Its cause. English: “This computer has no position, so there are no distances.”</extracomment>
        <translation>Este equipo no tiene posición, así que no hay distancias.</translation>
    </message>
    <message>
        <source>CHECK_NO_MAP</source>
        <extracomment>A thing that is wrong. English: “A map can’t be drawn.”</extracomment>
        <translation>Un mapa no se puede dibujar.</translation>
    </message>
    <message>
        <source>CHECK_NO_LETTERS</source>
        <extracomment>A thing that is wrong. English: “Letters are missing.”</extracomment>
        <translation>Faltan letras.</translation>
    </message>
    <message>
        <source>CHECK_LETTERS_LINE</source>
        <extracomment>Its cause. English: “Some names show as boxes.”</extracomment>
        <translation>Algunos nombres se ven como cuadros.</translation>
    </message>
    <message>
        <source>CHECK_DEAF</source>
        <extracomment>A thing that is wrong. English: “Screen readers can’t listen.”</extracomment>
        <translation>Los lectores de pantalla no pueden escuchar.</translation>
    </message>
    <message>
        <source>CHECK_DEAF_LINE</source>
        <extracomment>Its cause. English: “What joins them to programs doesn’t answer.”</extracomment>
        <translation>Lo que los une a los programas no responde.</translation>
    </message>
    <message>
        <source>CHECK_NO_DESKTOP</source>
        <extracomment>A thing that is wrong. English: “The desktop doesn’t answer.”</extracomment>
        <translation>El escritorio no responde.</translation>
    </message>
    <message>
        <source>CHECK_NO_DESKTOP_LINE</source>
        <extracomment>Its cause. English: “Its colours and contrast aren’t followed, and links may not open.”</extracomment>
        <translation>No se siguen sus colores ni su contraste, y puede que no se abran enlaces.</translation>
    </message>
    <message>
        <source>SHARING_REFUSED</source>
        <extracomment>Under that switch, when the service does not do this. English: “Your service can’t change this here.”</extracomment>
        <translation>Tu servicio no puede cambiar esto aquí.</translation>
    </message>
</context>
</TS>
