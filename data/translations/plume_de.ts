<?xml version="1.0" encoding="utf-8"?>
<!DOCTYPE TS>
<TS version="2.1" language="de_DE" sourcelanguage="en_US">
<context>
    <name>AdvancedPage</name>
    <message>
        <source>Every setting by its name, as “plume settings” shows it. Values are JSON; those that you have set are bold. Press F2 to change one.</source>
        <translation>Alle Einstellungen mit ihrem Namen, wie „plume settings“ sie zeigt. Werte sind JSON; selbst gesetzte sind fett. F2 ändert einen Wert.</translation>
    </message>
    <message>
        <source>All settings</source>
        <translation>Alle Einstellungen</translation>
    </message>
    <message>
        <source>Filter settings</source>
        <translation>Einstellungen filtern</translation>
    </message>
    <message>
        <source>&amp;Change…</source>
        <translation>Ä&amp;ndern…</translation>
    </message>
    <message>
        <source>&amp;Use Default</source>
        <translation>&amp;Standard verwenden</translation>
    </message>
    <message>
        <source>&amp;Show Diagnostics</source>
        <translation>&amp;Diagnose anzeigen</translation>
    </message>
</context>
<context>
    <name>Application</name>
    <message>
        <source>There is already one or more instance(s) of Plume running.</source>
        <translation>Plume läuft bereits.</translation>
    </message>
    <message>
        <source>This instance will exit and bring other instances to front.</source>
        <translation>Dieses Programm wird beendet und das bereits laufende nach vorn geholt.</translation>
    </message>
</context>
<context>
    <name>ApplicationServices</name>
    <message>
        <source>1 snippet was imported.</source>
        <translation>1 Snippet wurde importiert.</translation>
    </message>
    <message numerus="yes">
        <source>%n snippets were imported.</source>
        <translation>
            <numerusform>%n Snippet wurde importiert.</numerusform>
            <numerusform>%n Snippets wurden importiert.</numerusform>
        </translation>
    </message>
</context>
<context>
    <name>ApplicationsPage</name>
    <message>
        <source>Plume knows how many programs want to be typed to. Add a program where texts arrive damaged, or not at all.</source>
        <translation>Plume weiß von vielen Programmen, wie Texte bei ihnen ankommen. Kommen sie in einem Programm beschädigt an oder gar nicht, lässt es sich hier hinzufügen.</translation>
    </message>
    <message>
        <source>Programs</source>
        <translation>Programme</translation>
    </message>
    <message>
        <source>How texts are inserted in the chosen program</source>
        <translation>Wie Texte im gewählten Programm eingesetzt werden</translation>
    </message>
    <message>
        <source>Filter programs</source>
        <translation>Programme filtern</translation>
    </message>
    <message>
        <source>Change as &amp;Mine</source>
        <translation>Als &amp;eigene übernehmen</translation>
    </message>
    <message>
        <source>Makes a row of your own that begins as this one of Plume’s.</source>
        <translation>Legt eine eigene Zeile an, die wie diese von Plume beginnt.</translation>
    </message>
    <message>
        <source>Remo&amp;ve</source>
        <translation>Entfe&amp;rnen</translation>
    </message>
    <message>
        <source>Program</source>
        <translation>Programm</translation>
    </message>
    <message>
        <source>Identifier</source>
        <translation>Kennung</translation>
    </message>
    <message>
        <source>Row of</source>
        <translation>Herkunft</translation>
    </message>
    <message>
        <source>Kind</source>
        <translation>Art</translation>
    </message>
    <message>
        <source>Yours</source>
        <translation>Eigene</translation>
    </message>
    <message>
        <source>Plume</source>
        <translation>Plume</translation>
    </message>
    <message>
        <source>Automatic</source>
        <translation>Automatisch</translation>
    </message>
    <message>
        <source>Typed</source>
        <translation>Getippt</translation>
    </message>
    <message>
        <source>Pasted</source>
        <translation>Eingefügt</translation>
    </message>
    <message>
        <source>&amp;Insert texts:</source>
        <translation>Texte ein&amp;setzen:</translation>
    </message>
    <message>
        <source>As usual</source>
        <translation>Wie üblich</translation>
    </message>
    <message>
        <source>&amp;Keys that paste:</source>
        <translation>&amp;Tasten zum Einfügen:</translation>
    </message>
    <message>
        <source>Pause &amp;before pasting:</source>
        <translation>Pause &amp;vor dem Einfügen:</translation>
    </message>
    <message>
        <source>Pause &amp;after pasting:</source>
        <translation>Pause &amp;nach dem Einfügen:</translation>
    </message>
    <message>
        <source>Pause after &amp;erasing:</source>
        <translation>Pause nach dem &amp;Löschen:</translation>
    </message>
    <message>
        <source>Try it: click in the program and type an abbreviation. Changes hold at once.</source>
        <translation>Zum Ausprobieren ins Programm klicken und ein Kürzel tippen. Änderungen gelten sofort.</translation>
    </message>
    <message>
        <source> seconds</source>
        <translation> Sekunden</translation>
    </message>
</context>
<context>
    <name>BackupsPage</name>
    <message>
        <source>Backups</source>
        <translation>Sicherungen</translation>
    </message>
    <message>
        <source>Folder of backups</source>
        <translation>Ordner der Sicherungen</translation>
    </message>
    <message>
        <source>F&amp;older:</source>
        <translation>&amp;Ordner:</translation>
    </message>
    <message>
        <source> backup</source>
        <translation> Sicherung</translation>
    </message>
    <message numerus="yes">
        <source> backups</source>
        <translation>
            <numerusform> Sicherung</numerusform>
            <numerusform> Sicherungen</numerusform>
        </translation>
    </message>
    <message>
        <source>&amp;Keep:</source>
        <translation>&amp;Behalten:</translation>
    </message>
    <message>
        <source>The oldest go when there are more.</source>
        <translation>Sind es mehr, werden die ältesten gelöscht.</translation>
    </message>
    <message>
        <source>All backups</source>
        <translation>Alle Sicherungen</translation>
    </message>
    <message>
        <source>Never</source>
        <translation>Nie</translation>
    </message>
    <message>
        <source>Every hour</source>
        <translation>Stündlich</translation>
    </message>
    <message>
        <source>Every day</source>
        <translation>Täglich</translation>
    </message>
    <message>
        <source>Every week</source>
        <translation>Wöchentlich</translation>
    </message>
    <message>
        <source>Every 30 days</source>
        <translation>Alle 30 Tage</translation>
    </message>
    <message>
        <source>Back &amp;up:</source>
        <translation>&amp;Sichern:</translation>
    </message>
    <message>
        <source>&amp;Back Up Now</source>
        <translation>&amp;Jetzt sichern</translation>
    </message>
    <message>
        <source>&amp;Restore…</source>
        <translation>Wiederherst&amp;ellen…</translation>
    </message>
    <message>
        <source>Back Up Now, Restore</source>
        <translation>Jetzt sichern, wiederherstellen</translation>
    </message>
    <message>
        <source>No backup was made. %1</source>
        <translation>Es wurde nichts gesichert. %1</translation>
    </message>
    <message>
        <source>Written: %1</source>
        <translation>Geschrieben: %1</translation>
    </message>
    <message>
        <source>There is no backup in this folder yet.</source>
        <translation>In diesem Ordner ist noch keine Sicherung.</translation>
    </message>
    <message>
        <source>There is 1 backup.</source>
        <translation>Es gibt 1 Sicherung.</translation>
    </message>
    <message numerus="yes">
        <source>There are %n backups.</source>
        <translation>
            <numerusform>Es gibt %n Sicherung.</numerusform>
            <numerusform>Es gibt %n Sicherungen.</numerusform>
        </translation>
    </message>
    <message>
        <source>The newest was made %1.</source>
        <translation>Die neueste ist vom %1.</translation>
    </message>
    <message>
        <source>Sync</source>
        <translation>Abgleich</translation>
    </message>
    <message>
        <source>Keep the library in &amp;step with other computers</source>
        <translation>Bibliothek mit anderen &amp;Computern abgleichen</translation>
    </message>
    <message>
        <source>By a file in a folder that these computers share.</source>
        <translation>Über eine Datei in einem Ordner, den diese Computer teilen.</translation>
    </message>
    <message>
        <source>Shared folder</source>
        <translation>Gemeinsamer Ordner</translation>
    </message>
    <message>
        <source>Shared &amp;folder:</source>
        <translation>&amp;Gemeinsamer Ordner:</translation>
    </message>
    <message>
        <source>Some settings &amp;go along</source>
        <translation>Einige Einstellungen &amp;mitnehmen</translation>
    </message>
    <message>
        <source>Those of the pages Typing and clipboard, and Correction.</source>
        <translation>Die der Seiten „Tippen und Zwischenablage“ und „Korrektur“.</translation>
    </message>
    <message>
        <source>Nothing is kept in step yet: choose a folder that exists.</source>
        <translation>Noch wird nichts abgeglichen: bitte einen vorhandenen Ordner wählen.</translation>
    </message>
</context>
<context>
    <name>CaseReset</name>
    <message>
        <source>Typed exactly as it is written</source>
        <translation>Genau wie geschrieben getippt</translation>
    </message>
    <message>
        <source>Typed in capitals or not</source>
        <translation>Groß oder klein getippt</translation>
    </message>
    <message>
        <source>Typed in capitals or not, and the text adapts</source>
        <translation>Groß oder klein getippt, und der Text passt sich an</translation>
    </message>
    <message>
        <source>Reset Case Sensitivity</source>
        <translation>Groß-/Kleinschreibung zurücksetzen</translation>
    </message>
    <message>
        <source>Case sensitivity of all snippets</source>
        <translation>Groß-/Kleinschreibung aller Snippets</translation>
    </message>
    <message>
        <source>Reset</source>
        <translation>Zurücksetzen</translation>
    </message>
    <message>
        <source>Cancel</source>
        <translation>Abbrechen</translation>
    </message>
    <message>
        <source>This will reset case sensitivity of all snippets in group to default setting.</source>
        <translation>Dies setzt die Groß-/Kleinschreibung aller Snippets der Gruppe auf die Voreinstellung zurück.</translation>
    </message>
    <message>
        <source>You can undo this action.</source>
        <translation>Dies lässt sich rückgängig machen.</translation>
    </message>
</context>
<context>
    <name>ChipWords</name>
    <message>
        <source>today</source>
        <translation>heute</translation>
    </message>
    <message>
        <source>1 year</source>
        <translation>1 Jahr</translation>
    </message>
    <message>
        <source>%1 years</source>
        <translation>%1 Jahre</translation>
    </message>
    <message>
        <source>1 month</source>
        <translation>1 Monat</translation>
    </message>
    <message>
        <source>%1 months</source>
        <translation>%1 Monate</translation>
    </message>
    <message>
        <source>1 week</source>
        <translation>1 Woche</translation>
    </message>
    <message>
        <source>%1 weeks</source>
        <translation>%1 Wochen</translation>
    </message>
    <message>
        <source>1 day</source>
        <translation>1 Tag</translation>
    </message>
    <message>
        <source>%1 days</source>
        <translation>%1 Tage</translation>
    </message>
    <message>
        <source>now</source>
        <translation>jetzt</translation>
    </message>
    <message>
        <source>1 hour</source>
        <translation>1 Stunde</translation>
    </message>
    <message>
        <source>%1 hours</source>
        <translation>%1 Stunden</translation>
    </message>
    <message>
        <source>1 minute</source>
        <translation>1 Minute</translation>
    </message>
    <message>
        <source>%1 minutes</source>
        <translation>%1 Minuten</translation>
    </message>
    <message>
        <source>1 second</source>
        <translation>1 Sekunde</translation>
    </message>
    <message>
        <source>%1 seconds</source>
        <translation>%1 Sekunden</translation>
    </message>
    <message>
        <source>%1 (optional, ticked)</source>
        <translation>%1 (optional, angekreuzt)</translation>
    </message>
    <message>
        <source>%1 (optional)</source>
        <translation>%1 (optional)</translation>
    </message>
    <message>
        <source>Snippet</source>
        <translation>Snippet</translation>
    </message>
    <message>
        <source>Caret</source>
        <translation>Schreibmarke</translation>
    </message>
    <message>
        <source>next %1</source>
        <translation>nächster %1</translation>
    </message>
    <message>
        <source>previous %1</source>
        <translation>voriger %1</translation>
    </message>
    <message>
        <source>Date</source>
        <translation>Datum</translation>
    </message>
    <message>
        <source>Time</source>
        <translation>Uhrzeit</translation>
    </message>
    <message>
        <source>Clipboard</source>
        <translation>Zwischenablage</translation>
    </message>
    <message>
        <source>without %1</source>
        <translation>ohne %1</translation>
    </message>
    <message>
        <source>Text area</source>
        <translation>Textbereich</translation>
    </message>
    <message>
        <source>Menu</source>
        <translation>Menü</translation>
    </message>
    <message>
        <source>Number</source>
        <translation>Zahl</translation>
    </message>
    <message>
        <source>Field</source>
        <translation>Feld</translation>
    </message>
    <message>
        <source>Ctrl</source>
        <translation>Strg</translation>
    </message>
    <message>
        <source>Alt</source>
        <translation>Alt</translation>
    </message>
    <message>
        <source>Shift</source>
        <translation>Umschalt</translation>
    </message>
    <message>
        <source>Super</source>
        <translation>Super</translation>
    </message>
    <message>
        <source>Key</source>
        <translation>Taste</translation>
    </message>
    <message>
        <source>, after %1 s</source>
        <translation>, nach %1 s</translation>
    </message>
</context>
<context>
    <name>CorrectionPage</name>
    <message>
        <source>Sentences</source>
        <translation>Sätze</translation>
    </message>
    <message>
        <source>Begin every &amp;sentence with a capital</source>
        <translation>Jeden &amp;Satz groß beginnen</translation>
    </message>
    <message>
        <source>&amp;No sentence ends with:</source>
        <translation>&amp;Kein Satzende nach:</translation>
    </message>
    <message>
        <source>One in each line.</source>
        <translation>Ein Eintrag pro Zeile.</translation>
    </message>
    <message>
        <source>Words</source>
        <translation>Wörter</translation>
    </message>
    <message>
        <source>Correct &amp;two capitals at the start of a word</source>
        <translation>&amp;Zwei Großbuchstaben am Wortanfang korrigieren</translation>
    </message>
    <message>
        <source>&amp;Leave these words:</source>
        <translation>&amp;Außer diesen Wörtern:</translation>
    </message>
    <message>
        <source>Where</source>
        <translation>Wo</translation>
    </message>
    <message>
        <source>&amp;Correct:</source>
        <translation>K&amp;orrigieren:</translation>
    </message>
    <message>
        <source>&amp;Keyboard layouts:</source>
        <translation>&amp;Tastaturbelegungen:</translation>
    </message>
    <message>
        <source>With all layouts</source>
        <translation>Bei allen Belegungen</translation>
    </message>
    <message>
        <source>With all layouts except those below</source>
        <translation>Bei allen Belegungen außer den folgenden</translation>
    </message>
    <message>
        <source>Only with the layouts below</source>
        <translation>Nur bei den folgenden Belegungen</translation>
    </message>
    <message>
        <source>Layo&amp;uts:</source>
        <translation>&amp;Belegungen:</translation>
    </message>
    <message>
        <source>One in each line, like “us”, “de(nodeadkeys)” or “ibus:libpinyin”.</source>
        <translation>Ein Eintrag pro Zeile, etwa „us“, „de(nodeadkeys)“ oder „ibus:libpinyin“.</translation>
    </message>
</context>
<context>
    <name>DecisionWords</name>
    <message>
        <source>expanded</source>
        <translation>ersetzt</translation>
    </message>
    <message>
        <source>expanded in %1</source>
        <translation>in %1 ersetzt</translation>
    </message>
    <message>
        <source>offered in a list, as one of several that match</source>
        <translation>in einer Liste angeboten, als eines von mehreren, die passen</translation>
    </message>
    <message>
        <source>its content could not be expanded</source>
        <translation>sein Inhalt ließ sich nicht einsetzen</translation>
    </message>
    <message>
        <source>the group is not meant for a program that Plume cannot name</source>
        <translation>die Gruppe gilt nicht für ein Programm, das Plume nicht erkennt</translation>
    </message>
    <message>
        <source>the group is not meant for %1</source>
        <translation>die Gruppe gilt nicht für %1</translation>
    </message>
    <message>
        <source>the group is not meant for this keyboard layout or input method</source>
        <translation>die Gruppe gilt nicht für diese Tastaturbelegung oder Eingabemethode</translation>
    </message>
    <message>
        <source>its capital and small letters were typed differently</source>
        <translation>Groß- und Kleinbuchstaben wurden anders getippt</translation>
    </message>
    <message>
        <source>the group does not expand after the key that followed</source>
        <translation>die Gruppe ersetzt nicht nach der Taste, die folgte</translation>
    </message>
    <message>
        <source>Plume was switched off</source>
        <translation>Plume wurde ausgeschaltet</translation>
    </message>
    <message>
        <source>Plume was switched on</source>
        <translation>Plume wurde eingeschaltet</translation>
    </message>
    <message>
        <source>a password field or another program kept the keyboard to itself</source>
        <translation>ein Passwortfeld oder ein anderes Programm hat die Tastatur für sich behalten</translation>
    </message>
    <message>
        <source>Plume could hear the keyboard again</source>
        <translation>Plume konnte die Tastatur wieder hören</translation>
    </message>
    <message>
        <source>no space or other delimiter stood before it</source>
        <translation>davor stand kein Leerzeichen oder anderes Trennzeichen</translation>
    </message>
    <message>
        <source>no space or new line stood before it</source>
        <translation>davor stand kein Leerzeichen und keine neue Zeile</translation>
    </message>
    <message>
        <source>no number stood before it</source>
        <translation>davor stand keine Zahl</translation>
    </message>
    <message>
        <source>part of its prefix stood before it once more</source>
        <translation>davor stand ein Teil seines Präfixes noch einmal</translation>
    </message>
    <message>
        <source>the group wants something else before it</source>
        <translation>die Gruppe verlangt davor etwas anderes</translation>
    </message>
    <message>
        <source>“%1”</source>
        <translation>„%1“</translation>
    </message>
    <message>
        <source>“%1” (group %2)</source>
        <translation>„%1“ (Gruppe %2)</translation>
    </message>
    <message>
        <source>%1 was %2.</source>
        <extracomment>%1 is an abbreviation, %2 for example &quot;expanded in xterm&quot;</extracomment>
        <translation>Das Kürzel %1 wurde %2.</translation>
    </message>
    <message>
        <source>%1.</source>
        <translation>%1.</translation>
    </message>
    <message>
        <source>%1 did not expand: %2.</source>
        <extracomment>%1 is an abbreviation, %2 for example &quot;the group is not meant for xterm&quot;</extracomment>
        <translation>Das Kürzel %1 wurde nicht ersetzt: %2.</translation>
    </message>
    <message>
        <source>Choose from the list, or give each snippet an abbreviation of its own.</source>
        <translation>Aus der Liste wählen oder jedem Snippet ein eigenes Kürzel geben.</translation>
    </message>
    <message>
        <source>Have a look at the snippet’s content. What was wrong with it may have been reported.</source>
        <translation>Den Inhalt des Snippets prüfen. Was daran nicht stimmt, steht vielleicht in den Meldungen.</translation>
    </message>
    <message>
        <source>Change the list of programs in the group’s settings.</source>
        <translation>Die Liste der Programme in den Einstellungen der Gruppe ändern.</translation>
    </message>
    <message>
        <source>Change to another keyboard layout, or change the list of them in the group’s settings.</source>
        <translation>Zu einer anderen Tastaturbelegung wechseln oder ihre Liste in den Einstellungen der Gruppe ändern.</translation>
    </message>
    <message>
        <source>Type it where that fits, or change in the group’s settings what must stand before an abbreviation.</source>
        <translation>Das Kürzel dort tippen, wo es passt, oder in den Einstellungen der Gruppe ändern, was vor einem Kürzel stehen muss.</translation>
    </message>
    <message>
        <source>Type it as it is written here, or let the snippet ignore case.</source>
        <translation>Das Kürzel so tippen, wie es hier steht, oder das Snippet Groß- und Kleinschreibung ignorieren lassen.</translation>
    </message>
    <message>
        <source>Type one of the group’s own delimiters, or add this one to them in the group’s settings.</source>
        <translation>Eines der Trennzeichen der Gruppe tippen oder dieses in den Einstellungen der Gruppe hinzufügen.</translation>
    </message>
    <message>
        <source>Nothing expands until you switch Plume on in the menu of its icon.</source>
        <translation>Nichts wird ersetzt, bis Plume im Menü seines Symbols wieder eingeschaltet wird.</translation>
    </message>
    <message>
        <source>Nothing expands until you leave the field, or the other program lets the keyboard go.</source>
        <translation>Nichts wird ersetzt, bis das Feld verlassen ist oder das andere Programm die Tastatur freigibt.</translation>
    </message>
</context>
<context>
    <name>ExpansionPage</name>
    <message>
        <source>Capitals</source>
        <translation>Großbuchstaben</translation>
    </message>
    <message>
        <source>Mixed &amp;case gives every word a capital</source>
        <translation>Bei &amp;gemischter Schreibweise jedes Wort groß beginnen</translation>
    </message>
    <message>
        <source>Where a text adapts to how its abbreviation is typed: “bRb” gives every word a capital. Without this only one that ends with a capital does, like “bRB”.</source>
        <translation>Wo sich ein Text der Schreibweise seines Kürzels anpasst, beginnt bei „bRb“ jedes Wort groß. Sonst bewirkt das nur ein Kürzel, das mit einem Großbuchstaben endet, wie „bRB“.</translation>
    </message>
    <message>
        <source>Typing</source>
        <translation>Tippen</translation>
    </message>
    <message>
        <source>A mouse click &amp;ends the abbreviation</source>
        <translation>Ein &amp;Mausklick beendet das Kürzel</translation>
    </message>
    <message>
        <source>What was typed before a click and what is typed after it are then never one abbreviation.</source>
        <translation>Was vor und was nach einem Klick getippt wird, ist dann nie ein und dasselbe Kürzel.</translation>
    </message>
    <message>
        <source>Passwords</source>
        <translation>Passwörter</translation>
    </message>
    <message>
        <source>Let programs tell which fields are for &amp;passwords</source>
        <translation>&amp;Passwortfelder von Programmen melden lassen</translation>
    </message>
    <message>
        <source>Plume is deaf in these fields. Browsers and some other programs tell it only while the desktop’s accessibility is on, which this switches on when Plume starts. It costs these programs some time and memory.</source>
        <translation>In diesen Feldern hört Plume nicht zu. Browser und einige andere Programme melden sie nur, solange die Barrierefreiheit der Arbeitsumgebung eingeschaltet ist; das übernimmt Plume dann beim Start. Diese Programme kostet das etwas Zeit und Speicher.</translation>
    </message>
    <message>
        <source>Forms</source>
        <translation>Formulare</translation>
    </message>
    <message>
        <source>&amp;Fill in fields in a plain window</source>
        <translation>Felder in einem &amp;schlichten Fenster ausfüllen</translation>
    </message>
    <message>
        <source>Instead of a page that looks like the text. The program that draws pages needs some 200 MB while forms are in use, and goes ten minutes after the last one.</source>
        <translation>Statt in einer Seite, die wie der Text aussieht. Das Programm, das Seiten zeichnet, braucht etwa 200 MB, solange Formulare benutzt werden, und geht zehn Minuten nach dem letzten.</translation>
    </message>
</context>
<context>
    <name>FormWords</name>
    <message>
        <source>This is not a number.</source>
        <translation>Das ist keine Zahl.</translation>
    </message>
    <message>
        <source>This formula cannot be computed.</source>
        <translation>Diese Formel lässt sich nicht berechnen.</translation>
    </message>
    <message>
        <source>This formula depends on itself.</source>
        <translation>Diese Formel hängt von sich selbst ab.</translation>
    </message>
    <message>
        <source>A number is missing that this is computed from.</source>
        <translation>Eine Zahl fehlt, aus der dies berechnet wird.</translation>
    </message>
    <message>
        <source>%1 character, and what the script adds</source>
        <translation>%1 Zeichen, und was das Skript hinzufügt</translation>
    </message>
    <message numerus="yes">
        <source>%1 characters, and what the script adds</source>
        <translation>
            <numerusform>%1 Zeichen, und was das Skript hinzufügt</numerusform>
            <numerusform>%1 Zeichen, und was das Skript hinzufügt</numerusform>
        </translation>
    </message>
    <message>
        <source>%1 character</source>
        <translation>%1 Zeichen</translation>
    </message>
    <message numerus="yes">
        <source>%1 characters</source>
        <translation>
            <numerusform>%1 Zeichen</numerusform>
            <numerusform>%1 Zeichen</numerusform>
        </translation>
    </message>
    <message>
        <source>Return inserts</source>
        <translation>Eingabe setzt ein</translation>
    </message>
    <message>
        <source>Ctrl+Return inserts from anywhere</source>
        <translation>Strg+Eingabe setzt von überall ein</translation>
    </message>
    <message>
        <source>Alt+letter takes a part or leaves it out</source>
        <translation>Alt+Buchstabe nimmt einen Teil auf oder lässt ihn weg</translation>
    </message>
    <message>
        <source>Esc cancels</source>
        <translation>Esc bricht ab</translation>
    </message>
    <message>
        <source>Insert</source>
        <translation>Einfügen</translation>
    </message>
    <message>
        <source>Cancel</source>
        <translation>Abbrechen</translation>
    </message>
</context>
<context>
    <name>GeneralPage</name>
    <message>
        <source>Plume</source>
        <translation>Plume</translation>
    </message>
    <message>
        <source>&amp;Expand abbreviations</source>
        <translation>Kürzel &amp;ersetzen</translation>
    </message>
    <message>
        <source>Show the &amp;icon in the panel</source>
        <translation>Symbol in der &amp;Leiste anzeigen</translation>
    </message>
    <message>
        <source>Its menu leads to everything that Plume can do.</source>
        <translation>Sein Menü führt zu allem, was Plume kann.</translation>
    </message>
    <message>
        <source>Sound</source>
        <translation>Ton</translation>
    </message>
    <message>
        <source>&amp;Play a sound with every expansion</source>
        <translation>Bei jeder Ersetzung einen &amp;Ton abspielen</translation>
    </message>
    <message>
        <source>Text</source>
        <translation>Text</translation>
    </message>
    <message>
        <source> point</source>
        <translation> Punkt</translation>
    </message>
    <message numerus="yes">
        <source> points</source>
        <translation>
            <numerusform> Punkt</numerusform>
            <numerusform> Punkt</numerusform>
        </translation>
    </message>
    <message>
        <source>&amp;Larger text in lists:</source>
        <translation>&amp;Größere Schrift in Listen:</translation>
    </message>
    <message>
        <source>How much larger than usual lists and menus are written.</source>
        <translation>Um wie viel größer als üblich Listen und Menüs geschrieben sind.</translation>
    </message>
    <message>
        <source>&amp;Start Plume when I log in</source>
        <translation>Plume beim An&amp;melden starten</translation>
    </message>
    <message>
        <source>This could not be kept. %1</source>
        <translation>Das ließ sich nicht speichern. %1</translation>
    </message>
    <message>
        <source>&amp;Test</source>
        <translation>&amp;Anhören</translation>
    </message>
    <message>
        <source>Test the sound</source>
        <translation>Ton anhören</translation>
    </message>
    <message>
        <source>So&amp;und:</source>
        <translation>T&amp;on:</translation>
    </message>
    <message>
        <source>&amp;Font of new snippets:</source>
        <translation>&amp;Schrift neuer Snippets:</translation>
    </message>
    <message>
        <source>%1, %2 points…</source>
        <translation>%1, %2 Punkt…</translation>
    </message>
    <message>
        <source>Font of new snippets: %1</source>
        <translation>Schrift neuer Snippets: %1</translation>
    </message>
    <message>
        <source>Font of New Snippets</source>
        <translation>Schrift neuer Snippets</translation>
    </message>
</context>
<context>
    <name>GroupEffect</name>
    <message>
        <source>%1 %2</source>
        <translation>%1 %2</translation>
    </message>
    <message>
        <source>Typing %1 does nothing: these snippets are only chosen from lists.</source>
        <translation>Das Tippen von %1 bewirkt nichts: Diese Snippets werden nur aus Listen gewählt.</translation>
    </message>
    <message>
        <source>Typing %1 does nothing: the group is switched off in all programs.</source>
        <translation>Das Tippen von %1 bewirkt nichts: Die Gruppe ist in allen Programmen ausgeschaltet.</translation>
    </message>
    <message>
        <source>Typing %1 does nothing: no program is chosen yet.</source>
        <translation>Das Tippen von %1 bewirkt nichts: Noch ist kein Programm gewählt.</translation>
    </message>
    <message>
        <source>Typing %1 does nothing: no keyboard layout is chosen yet.</source>
        <translation>Das Tippen von %1 bewirkt nichts: Noch ist keine Tastaturbelegung gewählt.</translation>
    </message>
    <message>
        <source>Typing %1 does nothing: no character is chosen to expand it.</source>
        <translation>Das Tippen von %1 bewirkt nichts: Kein Zeichen zum Ersetzen ist gewählt.</translation>
    </message>
    <message>
        <source>in %1 only: %2</source>
        <translation>nur in %1: %2</translation>
    </message>
    <message>
        <source>everywhere but in %1: %2</source>
        <translation>überall außer in %1: %2</translation>
    </message>
    <message>
        <source>Not with the keyboard layout %1.</source>
        <translation>Nicht bei der Tastaturbelegung %1.</translation>
    </message>
    <message>
        <source>Not with the keyboard layouts %1.</source>
        <translation>Nicht bei den Tastaturbelegungen %1.</translation>
    </message>
    <message>
        <source>Only with the keyboard layout %1.</source>
        <translation>Nur bei der Tastaturbelegung %1.</translation>
    </message>
    <message>
        <source>Only with the keyboard layouts %1.</source>
        <translation>Nur bei den Tastaturbelegungen %1.</translation>
    </message>
    <message>
        <source>%1, then %2.</source>
        <translation>%1, dann %2.</translation>
    </message>
    <message>
        <source>%1, then %2, which is left out.</source>
        <translation>%1, dann %2; das Trennzeichen entfällt.</translation>
    </message>
    <message>
        <source>%1, then press the hot key that expands.</source>
        <translation>%1, dann das Tastenkürzel zum Ersetzen drücken.</translation>
    </message>
    <message>
        <source>%1, and it expands at once.</source>
        <translation>%1, und es wird sofort ersetzt.</translation>
    </message>
    <message>
        <source>type %1</source>
        <translation>das Kürzel %1 tippen</translation>
    </message>
    <message>
        <source>type %1 behind a space or in a new line</source>
        <translation>das Kürzel %1 hinter einem Leerzeichen oder in einer neuen Zeile tippen</translation>
    </message>
    <message>
        <source>type %1, even inside a word</source>
        <translation>das Kürzel %1 tippen, auch mitten im Wort</translation>
    </message>
    <message>
        <source>type %1 right behind a number</source>
        <translation>das Kürzel %1 direkt hinter einer Zahl tippen</translation>
    </message>
    <message>
        <source>type %1 before anything else</source>
        <translation>das Kürzel %1 vor allem anderen tippen</translation>
    </message>
    <message>
        <source>type %1 behind %2</source>
        <translation>erst %2, dann das Kürzel %1 tippen</translation>
    </message>
    <message>
        <source>“%1”</source>
        <translation>„%1“</translation>
    </message>
    <message>
        <source>a space, Return or a punctuation mark</source>
        <translation>ein Leerzeichen, die Eingabetaste oder ein Satzzeichen</translation>
    </message>
    <message>
        <source>a space</source>
        <translation>ein Leerzeichen</translation>
    </message>
    <message>
        <source>Tab</source>
        <translation>Tab</translation>
    </message>
    <message>
        <source>Return</source>
        <translation>die Eingabetaste</translation>
    </message>
    <message>
        <source>Enter</source>
        <translation>Enter</translation>
    </message>
    <message numerus="yes">
        <source>%n others</source>
        <translation>
            <numerusform>%n weiteren</numerusform>
            <numerusform>%n weiteren</numerusform>
        </translation>
    </message>
    <message>
        <source>%1 and %2</source>
        <translation>%1 und %2</translation>
    </message>
    <message>
        <source>, </source>
        <translation>, </translation>
    </message>
    <message numerus="yes">
        <source>one of %n others</source>
        <translation>
            <numerusform>eines von %n weiteren</numerusform>
            <numerusform>eines von %n weiteren</numerusform>
        </translation>
    </message>
    <message>
        <source>%1 or %2</source>
        <translation>%1 oder %2</translation>
    </message>
</context>
<context>
    <name>HotKeysPage</name>
    <message>
        <source>Switch expansion on and off</source>
        <translation>Ersetzen ein- und ausschalten</translation>
    </message>
    <message>
        <source>Expand the abbreviation just typed</source>
        <translation>Eben getipptes Kürzel ersetzen</translation>
    </message>
    <message>
        <source>Undo the last expansion</source>
        <translation>Letzte Ersetzung zurücknehmen</translation>
    </message>
    <message>
        <source>The key that caused it comes back too.</source>
        <translation>Auch die Taste, die sie ausgelöst hat, kommt zurück.</translation>
    </message>
    <message>
        <source>Undo without that key</source>
        <translation>Zurücknehmen ohne diese Taste</translation>
    </message>
    <message>
        <source>Only the abbreviation comes back.</source>
        <translation>Nur das Kürzel kommt zurück.</translation>
    </message>
    <message>
        <source>Suggest abbreviations</source>
        <translation>Kürzel vorschlagen</translation>
    </message>
    <message>
        <source>Quick search</source>
        <translation>Schnellsuche</translation>
    </message>
    <message>
        <source>Quick search, asked of the desktop</source>
        <translation>Schnellsuche über den Desktop</translation>
    </message>
    <message>
        <source>Works also where Plume does not hear the keys.</source>
        <translation>Geht auch dort, wo Plume die Tasten nicht hört.</translation>
    </message>
    <message>
        <source>Open the snippets window</source>
        <translation>Snippet-Fenster öffnen</translation>
    </message>
    <message>
        <source>Open the snippet used last</source>
        <translation>Zuletzt benutztes Snippet öffnen</translation>
    </message>
    <message>
        <source>New snippet from the selection</source>
        <translation>Neues Snippet aus der Auswahl</translation>
    </message>
    <message>
        <source>New snippet from the clipboard</source>
        <translation>Neues Snippet aus der Zwischenablage</translation>
    </message>
    <message>
        <source>Click a field, or press Space in it, and then the keys that you want.</source>
        <translation>Ein Feld anklicken oder darin die Leertaste drücken, dann die gewünschten Tasten.</translation>
    </message>
    <message>
        <source>Expanding</source>
        <translation>Ersetzen</translation>
    </message>
    <message>
        <source>Finding snippets</source>
        <translation>Snippets finden</translation>
    </message>
    <message>
        <source>Making and changing snippets</source>
        <translation>Snippets anlegen und ändern</translation>
    </message>
</context>
<context>
    <name>ImportExportPage</name>
    <message>
        <source>Import</source>
        <translation>Import</translation>
    </message>
    <message>
        <source>&amp;Import a File…</source>
        <translation>Datei &amp;importieren…</translation>
    </message>
    <message>
        <source>Snippets of Plume or of another program are added to yours.</source>
        <translation>Snippets von Plume oder aus einem anderen Programm kommen zu den eigenen hinzu.</translation>
    </message>
    <message>
        <source>Export</source>
        <translation>Export</translation>
    </message>
    <message>
        <source>&amp;Export the Library…</source>
        <translation>Bibliothek &amp;exportieren…</translation>
    </message>
    <message>
        <source>All snippets go into one file, for another computer or another program.</source>
        <translation>Alle Snippets kommen in eine Datei, für einen anderen Computer oder ein anderes Programm.</translation>
    </message>
</context>
<context>
    <name>LibraryUndo</name>
    <message>
        <source>Change of Abbreviation</source>
        <translation>Änderung des Kürzels</translation>
    </message>
    <message>
        <source>Change of Label</source>
        <translation>Änderung der Bezeichnung</translation>
    </message>
    <message>
        <source>Change of Note</source>
        <translation>Änderung der Notiz</translation>
    </message>
    <message>
        <source>Change of Case</source>
        <translation>Änderung der Schreibweise</translation>
    </message>
    <message>
        <source>Change of Kind</source>
        <translation>Änderung der Art</translation>
    </message>
    <message>
        <source>Change of Content</source>
        <translation>Änderung des Inhalts</translation>
    </message>
    <message>
        <source>Change of Group Name</source>
        <translation>Änderung des Gruppennamens</translation>
    </message>
    <message>
        <source>Change of Group Settings</source>
        <translation>Änderung der Gruppeneinstellungen</translation>
    </message>
    <message>
        <source>New Snippets (%n)</source>
        <translation>Neue Snippets (%n)</translation>
    </message>
    <message>
        <source>New Groups (%n)</source>
        <translation>Neue Gruppen (%n)</translation>
    </message>
    <message>
        <source>Deletion (%n)</source>
        <translation>Löschen (%n)</translation>
    </message>
    <message>
        <source>Move (%n)</source>
        <translation>Verschieben (%n)</translation>
    </message>
    <message>
        <source>Copy (%n)</source>
        <translation>Kopieren (%n)</translation>
    </message>
    <message>
        <source>Duplication (%n)</source>
        <translation>Duplizieren (%n)</translation>
    </message>
    <message>
        <source>Deletion of Duplicates (%n)</source>
        <translation>Löschen von Duplikaten (%n)</translation>
    </message>
    <message>
        <source>Sorting</source>
        <translation>Sortieren</translation>
    </message>
    <message>
        <source>Sorting of Groups</source>
        <translation>Sortieren der Gruppen</translation>
    </message>
    <message>
        <source>Reset of Case (%n)</source>
        <translation>Zurücksetzen der Schreibweise (%n)</translation>
    </message>
    <message>
        <source>New Group</source>
        <translation>Neue Gruppe</translation>
    </message>
    <message>
        <source>Import</source>
        <translation>Import</translation>
    </message>
    <message>
        <source>Kept Edit</source>
        <translation>Bewahrte Bearbeitung</translation>
    </message>
</context>
<context>
    <name>MenuTexts</name>
    <message>
        <source>Empty snippet</source>
        <translation>Leeres Snippet</translation>
    </message>
    <message>
        <source>%1 — %2</source>
        <extracomment>%1 is an abbreviation, %2 what it stands for.</extracomment>
        <translation>%1 – %2</translation>
    </message>
</context>
<context>
    <name>SearchPage</name>
    <message>
        <source>Lists at the caret</source>
        <translation>Listen an der Schreibmarke</translation>
    </message>
    <message>
        <source>&amp;Key held to pick with a digit:</source>
        <translation>&amp;Taste zum Wählen per Ziffer:</translation>
    </message>
    <message>
        <source>None</source>
        <translation>Keine</translation>
    </message>
    <message>
        <source>Shift</source>
        <translation>Umschalt</translation>
    </message>
    <message>
        <source>Control</source>
        <translation>Strg</translation>
    </message>
    <message>
        <source>Alt</source>
        <translation>Alt</translation>
    </message>
    <message>
        <source>Super</source>
        <translation>Super</translation>
    </message>
    <message>
        <source>Quick search looks in</source>
        <translation>Die Schnellsuche durchsucht</translation>
    </message>
    <message>
        <source>&amp;Abbreviations</source>
        <translation>&amp;Kürzel</translation>
    </message>
    <message>
        <source>&amp;Contents</source>
        <translation>&amp;Inhalte</translation>
    </message>
    <message>
        <source>&amp;Labels</source>
        <translation>&amp;Bezeichnungen</translation>
    </message>
    <message>
        <source>&amp;Wildcards in quick search</source>
        <translation>&amp;Platzhalter in der Schnellsuche</translation>
    </message>
    <message>
        <source>* stands for any text, and ? for any character.</source>
        <translation>* steht für beliebigen Text und ? für ein beliebiges Zeichen.</translation>
    </message>
    <message>
        <source>The snippets window looks in</source>
        <translation>Das Snippet-Fenster durchsucht</translation>
    </message>
    <message>
        <source>A&amp;bbreviations</source>
        <translation>Kü&amp;rzel</translation>
    </message>
    <message>
        <source>C&amp;ontents</source>
        <translation>In&amp;halte</translation>
    </message>
    <message>
        <source>Lab&amp;els</source>
        <translation>Be&amp;zeichnungen</translation>
    </message>
    <message>
        <source>At least one is needed.</source>
        <translation>Eines davon muss gewählt bleiben.</translation>
    </message>
    <message>
        <source>&amp;Suggest snippets while I type</source>
        <translation>Snippets beim Tippen &amp;vorschlagen</translation>
    </message>
    <message>
        <source>A list comes up by itself after a pause in an abbreviation of which two letters are typed. Return takes its selected snippet, Esc closes it.</source>
        <translation>Nach einer Pause in einem Kürzel, von dem zwei Buchstaben getippt sind, erscheint von selbst eine Liste. Die Eingabetaste nimmt das ausgewählte Snippet, Esc schließt sie.</translation>
    </message>
    <message>
        <source>Quick search</source>
        <translation>Schnellsuche</translation>
    </message>
    <message>
        <source>Be&amp;gin with the word before the caret</source>
        <translation>&amp;Mit dem Wort vor der Schreibmarke beginnen</translation>
    </message>
    <message>
        <source>The snippet that is chosen takes its place then.</source>
        <translation>Das gewählte Snippet tritt dann an seine Stelle.</translation>
    </message>
    <message>
        <source>Show often &amp;used snippets first</source>
        <translation>&amp;Oft benutzte Snippets zuerst zeigen</translation>
    </message>
    <message>
        <source>How often each snippet is used is kept on this computer, never what was searched for.</source>
        <translation>Wie oft jedes Snippet benutzt wird, bleibt auf diesem Computer gespeichert; wonach gesucht wurde, nie.</translation>
    </message>
    <message>
        <source>&amp;Forget How Often Snippets Were Used</source>
        <translation>Ver&amp;gessen, wie oft Snippets benutzt wurden</translation>
    </message>
    <message>
        <source>Forget How Often Snippets Were Used</source>
        <translation>Vergessen, wie oft Snippets benutzt wurden</translation>
    </message>
    <message>
        <source>In suggestions and in quick search, the digits 1 to 9 pick a snippet while this key is held, and 0 picks the tenth.</source>
        <translation>In Vorschlägen und in der Schnellsuche wählen die Ziffern 1 bis 9 ein Snippet, solange diese Taste gedrückt ist, und 0 wählt das zehnte.</translation>
    </message>
    <message>
        <source>Wildcards in the snippets w&amp;indow</source>
        <translation>Platzhalter im Snippet-&amp;Fenster</translation>
    </message>
</context>
<context>
    <name>Sentences</name>
    <message>
        <source>Plume is not working: it cannot hear the keyboard.</source>
        <translation>Plume arbeitet nicht: Es kann die Tastatur nicht hören.</translation>
    </message>
    <message>
        <source>%1 takes keys, too. When letters get lost or come twice, end one of the two.</source>
        <translation>%1 nimmt ebenfalls Tasten entgegen. Wenn Buchstaben verloren gehen oder doppelt kommen, eines der beiden Programme beenden.</translation>
    </message>
    <message>
        <source>Listening to the keyboard was ended three times within a minute, because Plume did not answer in time. It is tried again in a minute.</source>
        <translation>Das Mithören der Tastatur wurde dreimal innerhalb einer Minute beendet, weil Plume nicht rechtzeitig geantwortet hat. In einer Minute wird es wieder versucht.</translation>
    </message>
    <message>
        <source>Plume does not listen</source>
        <translation>Plume hört nicht zu</translation>
    </message>
    <message>
        <source>Listen now</source>
        <translation>Jetzt zuhören</translation>
    </message>
    <message>
        <source>Show Reports</source>
        <translation>Meldungen zeigen</translation>
    </message>
    <message>
        <source>The snippet was not sent: another program holds the keyboard, or a password is asked for.</source>
        <translation>Das Snippet wurde nicht gesendet: Ein anderes Programm hält die Tastatur fest, oder es wird nach einem Passwort gefragt.</translation>
    </message>
    <message>
        <source>Another hot key of Plume&apos;s has this combination already.</source>
        <translation>Eine andere Tastenkombination von Plume ist schon so belegt.</translation>
    </message>
    <message>
        <source>Another program has this combination as its hot key already: choose another.</source>
        <translation>Ein anderes Programm verwendet diese Tastenkombination schon: eine andere wählen.</translation>
    </message>
    <message>
        <source>The keyboard has no key with code %1 for the hot key.</source>
        <translation>Die Tastatur hat keine Taste mit dem Code %1 für die Tastenkombination.</translation>
    </message>
    <message>
        <source>The keyboard &quot;%1&quot; of display &quot;%2&quot; is held by another program, perhaps another Plume or key tool: end that program.</source>
        <translation>Die Tastatur „%1“ des Bildschirms „%2“ wird von einem anderen Programm festgehalten, vielleicht von einem anderen Plume oder einem Tastenwerkzeug: dieses Programm beenden.</translation>
    </message>
    <message>
        <source>The X server &quot;%1&quot; lacks the XFIXES extension, which Plume needs to follow the clipboard: switch it on.</source>
        <translation>Dem X-Server „%1“ fehlt die Erweiterung XFIXES, mit der Plume der Zwischenablage folgt: sie einschalten.</translation>
    </message>
    <message>
        <source>The keyboard layout of the X display &quot;%1&quot; cannot be read: Plume needs an X server with the XKB extension.</source>
        <translation>Die Tastaturbelegung des X-Bildschirms „%1“ kann nicht gelesen werden: Plume braucht einen X-Server mit der Erweiterung XKB.</translation>
    </message>
    <message>
        <source>The X server of display &quot;%1&quot; lacks an XTEST keyboard on the main keyboard: was it removed with xinput?</source>
        <translation>Dem X-Server des Bildschirms „%1“ fehlt eine XTEST-Tastatur an der Haupttastatur: Wurde sie mit xinput entfernt?</translation>
    </message>
    <message>
        <source>The X server of display &quot;%1&quot; lacks %2</source>
        <translation>Dem X-Server des Bildschirms „%1“ fehlt: %2</translation>
    </message>
    <message>
        <source>Password fields in browsers</source>
        <translation>Passwortfelder in Browsern</translation>
    </message>
    <message>
        <source>Browsers and Qt programs tell Plume which field takes a password only while the desktop&apos;s accessibility is on, which makes them a little slower; until then Plume hears passwords that are typed there. %1</source>
        <translation>Browser und Qt-Programme sagen Plume nur, welches Feld ein Passwort aufnimmt, solange die Barrierefreiheit des Desktops eingeschaltet ist, was sie ein wenig langsamer macht; bis dahin hört Plume Passwörter mit, die dort getippt werden. %1</translation>
    </message>
    <message>
        <source>Your answer is kept; &quot;plume settings %1&quot; shows it.</source>
        <translation>Die Antwort wird gemerkt; „plume settings %1“ zeigt sie.</translation>
    </message>
    <message>
        <source>Switch on</source>
        <translation>Einschalten</translation>
    </message>
    <message>
        <source>Not now</source>
        <translation>Nicht jetzt</translation>
    </message>
    <message>
        <source>Programs tell about their password fields now; Chromium has to be started again. %1</source>
        <translation>Programme melden ihre Passwortfelder jetzt; Chromium muss neu gestartet werden. %1</translation>
    </message>
    <message>
        <source>The answer is not kept: %1</source>
        <translation>Die Antwort wird nicht gemerkt: %1</translation>
    </message>
    <message>
        <source>%1 is %2 from now on.</source>
        <translation>%1 ist von jetzt an %2.</translation>
    </message>
    <message>
        <source>Several snippets match &quot;%1&quot;, and there is no list here to choose from.</source>
        <translation>Mehrere Snippets passen zu „%1“, und es gibt hier keine Liste zum Auswählen.</translation>
    </message>
    <message>
        <source>The snippet &quot;%1&quot; has fields to fill in, and there is no form here to do it.</source>
        <translation>Das Snippet „%1“ hat Felder zum Ausfüllen, und es gibt hier kein Formular dafür.</translation>
    </message>
    <message>
        <source>The snippet &quot;%1&quot; is not expanded, because its content never ends or is too long; check whether snippets include each other.</source>
        <translation>Das Snippet „%1“ wird nicht eingesetzt, weil sein Inhalt nie endet oder zu lang ist; prüfen, ob Snippets einander enthalten.</translation>
    </message>
    <message>
        <source>AppleScript snippets cannot run on this system: there is no %1.</source>
        <translation>Snippets in AppleScript können auf diesem System nicht laufen: Es gibt kein %1.</translation>
    </message>
    <message>
        <source>A script was ended because it wrote more than %1 million characters.</source>
        <translation>Ein Skript wurde beendet, weil es mehr als %1 Millionen Zeichen schrieb.</translation>
    </message>
    <message>
        <source>A script could not be run: the system gives no further thread.</source>
        <translation>Ein Skript konnte nicht laufen: Das System gibt keinen weiteren Thread her.</translation>
    </message>
    <message>
        <source>A script could not be run: %1.</source>
        <translation>Ein Skript konnte nicht laufen: %1.</translation>
    </message>
    <message>
        <source>Your library cannot be opened.</source>
        <translation>Die Bibliothek lässt sich nicht öffnen.</translation>
    </message>
    <message>
        <source>The library could not be exported.</source>
        <translation>Die Bibliothek konnte nicht exportiert werden.</translation>
    </message>
    <message>
        <source>The file could not be restored.</source>
        <translation>Die Datei konnte nicht wiederhergestellt werden.</translation>
    </message>
    <message>
        <source>The file could not be imported.</source>
        <translation>Die Datei konnte nicht importiert werden.</translation>
    </message>
    <message>
        <source>The library was damaged</source>
        <translation>Die Bibliothek war beschädigt</translation>
    </message>
    <message>
        <source>The library was damaged, and there is no backup of it.</source>
        <translation>Die Bibliothek war beschädigt, und es gibt keine Sicherung von ihr.</translation>
    </message>
    <message>
        <source>The library was damaged. The newest backup is %1. What could not be read is kept beside it.</source>
        <translation>Die Bibliothek war beschädigt. Die neueste Sicherung ist %1. Was nicht zu lesen war, liegt daneben.</translation>
    </message>
    <message>
        <source>Restore</source>
        <translation>Wiederherstellen</translation>
    </message>
    <message>
        <source>The library cannot be read: %1. It is kept in %2.</source>
        <translation>Die Bibliothek kann nicht gelesen werden: %1. Sie liegt in %2.</translation>
    </message>
    <message>
        <source>The last changes of the library cannot be read: %1</source>
        <translation>Die letzten Änderungen der Bibliothek können nicht gelesen werden: %1</translation>
    </message>
    <message>
        <source>No backup was made: %1</source>
        <translation>Es wurde keine Sicherung angelegt: %1</translation>
    </message>
    <message>
        <source>An old backup stays: %1</source>
        <translation>Eine alte Sicherung bleibt: %1</translation>
    </message>
    <message>
        <source>nothing was replaced, because the library of now cannot be kept: %1</source>
        <translation>nichts wurde ersetzt, weil die jetzige Bibliothek nicht aufgehoben werden kann: %1</translation>
    </message>
    <message>
        <source>The sync folder %1 is not there; the library is sent when it comes.</source>
        <translation>Der Abgleichordner %1 ist nicht da; die Bibliothek wird gesendet, sobald er kommt.</translation>
    </message>
    <message>
        <source>Another machine had changed the library meanwhile; its version is kept in %1.</source>
        <translation>Ein anderer Rechner hatte die Bibliothek inzwischen geändert; seine Fassung liegt in %1.</translation>
    </message>
    <message>
        <source>The library was replaced by another machine&apos;s. What it held, with changes that were not sent yet, is in %1.</source>
        <translation>Die Bibliothek wurde durch die eines anderen Rechners ersetzt. Was sie enthielt, auch Änderungen, die noch nicht gesendet waren, liegt in %1.</translation>
    </message>
    <message>
        <source>The library is not sent, because the other one in the sync folder cannot be kept: %1</source>
        <translation>Die Bibliothek wird nicht gesendet, weil die andere im Abgleichordner nicht aufgehoben werden kann: %1</translation>
    </message>
    <message>
        <source>The library in the sync folder is not taken over, because this machine&apos;s cannot be kept: %1</source>
        <translation>Die Bibliothek im Abgleichordner wird nicht übernommen, weil die dieses Rechners nicht aufgehoben werden kann: %1</translation>
    </message>
    <message>
        <source>The library in the sync folder cannot be read and is left alone: %1</source>
        <translation>Die Bibliothek im Abgleichordner kann nicht gelesen werden und bleibt, wie sie ist: %1</translation>
    </message>
    <message>
        <source>The library was not sent to the sync folder: another machine writes it all the time</source>
        <translation>Die Bibliothek wurde nicht in den Abgleichordner gesendet: Ein anderer Rechner schreibt sie unablässig</translation>
    </message>
    <message>
        <source>The library was not sent to the sync folder: %1</source>
        <translation>Die Bibliothek wurde nicht in den Abgleichordner gesendet: %1</translation>
    </message>
    <message>
        <source>%1 cannot be read: %2</source>
        <translation>%1 kann nicht gelesen werden: %2</translation>
    </message>
    <message>
        <source>%1 cannot be written: %2</source>
        <translation>%1 kann nicht geschrieben werden: %2</translation>
    </message>
    <message>
        <source>%1 cannot be used: %2</source>
        <translation>%1 kann nicht benutzt werden: %2</translation>
    </message>
    <message>
        <source>A script was ended because it ran longer than %1.</source>
        <translation>Ein Skript wurde beendet, weil es länger als %1 lief.</translation>
    </message>
    <message>
        <source>1 second</source>
        <translation>1 Sekunde</translation>
    </message>
    <message>
        <source>%1 seconds</source>
        <translation>%1 Sekunden</translation>
    </message>
    <message>
        <source>The snippet was not sent: it is no longer in your library.</source>
        <translation>Das Snippet wurde nicht gesendet: Es ist nicht mehr in der Bibliothek.</translation>
    </message>
    <message>
        <source>The snippet was not sent: the window that it was for is gone, or does not take the keyboard.</source>
        <translation>Das Snippet wurde nicht gesendet: Das Fenster, für das es war, ist fort oder nimmt die Tastatur nicht an.</translation>
    </message>
    <message>
        <source>The window that it was for is gone, or does not take the keyboard.</source>
        <translation>Das Fenster, für das er bestimmt war, ist weg oder nimmt die Tastatur nicht an.</translation>
    </message>
    <message>
        <source>Another field has the focus than the one that it was for.</source>
        <translation>Ein anderes Feld hat den Fokus als das, für das er bestimmt war.</translation>
    </message>
    <message>
        <source>A form is shown as a plain window, because no page can be drawn: %1</source>
        <translation>Ein Formular wird als schlichtes Fenster gezeigt, weil keine Seite gezeichnet werden kann: %1</translation>
    </message>
    <message>
        <source>the program plume-form is not installed.</source>
        <translation>Das Programm plume-form ist nicht installiert.</translation>
    </message>
    <message>
        <source>The program that draws forms does not answer.</source>
        <translation>Das Programm, das Formulare zeichnet, antwortet nicht.</translation>
    </message>
    <message>
        <source>The program that draws forms cannot be started.</source>
        <translation>Das Programm, das Formulare zeichnet, lässt sich nicht starten.</translation>
    </message>
    <message>
        <source>The program that draws forms does not listen.</source>
        <translation>Das Programm, das Formulare zeichnet, hört nicht zu.</translation>
    </message>
    <message>
        <source>The program that draws forms says what cannot be.</source>
        <translation>Das Programm, das Formulare zeichnet, sagt, was nicht sein kann.</translation>
    </message>
    <message>
        <source>The program that draws forms has crashed.</source>
        <translation>Das Programm, das Formulare zeichnet, ist abgestürzt.</translation>
    </message>
    <message>
        <source>The program that draws forms has ended with %1.</source>
        <translation>Das Programm, das Formulare zeichnet, endete mit %1.</translation>
    </message>
</context>
<context>
    <name>SnippetRow</name>
    <message>
        <source>Shift+%1</source>
        <translation>Umschalt+%1</translation>
    </message>
    <message>
        <source>Ctrl+%1</source>
        <translation>Strg+%1</translation>
    </message>
    <message>
        <source>Alt+%1</source>
        <translation>Alt+%1</translation>
    </message>
    <message>
        <source>Super+%1</source>
        <translation>Super+%1</translation>
    </message>
</context>
<context>
    <name>TypingPage</name>
    <message>
        <source>Pasting</source>
        <translation>Einfügen</translation>
    </message>
    <message>
        <source>&amp;Paste texts instead of typing them</source>
        <translation>Texte einfügen statt &amp;tippen</translation>
    </message>
    <message>
        <source>Pasting is faster; typing leaves the clipboard alone.</source>
        <translation>Einfügen ist schneller; Tippen lässt die Zwischenablage in Ruhe.</translation>
    </message>
    <message>
        <source>P&amp;aste:</source>
        <translation>&amp;Einfügen:</translation>
    </message>
    <message>
        <source>Long texts</source>
        <translation>Lange Texte</translation>
    </message>
    <message>
        <source>Paste &amp;long texts everywhere</source>
        <translation>&amp;Lange Texte überall einfügen</translation>
    </message>
    <message>
        <source> character</source>
        <translation> Zeichen</translation>
    </message>
    <message numerus="yes">
        <source> characters</source>
        <translation>
            <numerusform> Zeichen</numerusform>
            <numerusform> Zeichen</numerusform>
        </translation>
    </message>
    <message>
        <source>Long &amp;from:</source>
        <translation>Lang &amp;ab:</translation>
    </message>
    <message>
        <source>What you copied</source>
        <translation>Kopiertes</translation>
    </message>
    <message>
        <source>&amp;Give back what was copied after a paste</source>
        <translation>Nach dem Einfügen das &amp;Kopierte zurückgeben</translation>
    </message>
    <message>
        <source>Give it back af&amp;ter:</source>
        <translation>&amp;Zurückgeben nach:</translation>
    </message>
    <message>
        <source>Programs that paste slowly need more.</source>
        <translation>Programme, die langsam einfügen, brauchen mehr.</translation>
    </message>
</context>
<context>
    <name>plume::AboutWindow</name>
    <message>
        <source>Library</source>
        <translation>Bibliothek</translation>
    </message>
    <message>
        <source>License</source>
        <translation>Lizenz</translation>
    </message>
    <message>
        <source>Libraries that Plume uses</source>
        <translation>Bibliotheken, die Plume benutzt</translation>
    </message>
    <message>
        <source>About Plume</source>
        <translation>Über Plume</translation>
    </message>
    <message>
        <source>Version %1</source>
        <translation>Version %1</translation>
    </message>
    <message>
        <source>Version</source>
        <translation>Version</translation>
    </message>
    <message>
        <source>Plume replaces the short abbreviations that you type by the texts that they stand for, in every program.</source>
        <translation>Plume ersetzt getippte Kürzel durch die Texte, für die sie stehen, in jedem Programm.</translation>
    </message>
    <message>
        <source>Plume is free software under the Apache License 2.0; its file LICENSE has the whole text.</source>
        <translation>Plume ist freie Software unter der Apache-Lizenz 2.0; die Datei LICENSE enthält den vollen Wortlaut.</translation>
    </message>
    <message>
        <source>Built with these &amp;libraries:</source>
        <translation>Erstellt mit diesen &amp;Bibliotheken:</translation>
    </message>
    <message>
        <source>&amp;Close</source>
        <translation>&amp;Schließen</translation>
    </message>
</context>
<context>
    <name>plume::ApplicationList</name>
    <message>
        <source>Remove</source>
        <translation>Entfernen</translation>
    </message>
    <message>
        <source>%1 is in the list already.</source>
        <translation>%1 steht schon in der Liste.</translation>
    </message>
</context>
<context>
    <name>plume::ChipForm</name>
    <message>
        <source>What it gives</source>
        <translation>Was es ergibt</translation>
    </message>
    <message>
        <source>Warning</source>
        <translation>Warnung</translation>
    </message>
    <message>
        <source>&amp;Done</source>
        <translation>&amp;Fertig</translation>
    </message>
    <message>
        <source>&amp;Cancel</source>
        <translation>&amp;Abbrechen</translation>
    </message>
    <message>
        <source>The sign %1 ends a placeholder and cannot stand in one.</source>
        <translation>Das Zeichen %1 beendet einen Platzhalter und kann nicht darin stehen.</translation>
    </message>
    <message>
        <source>⚠ %1</source>
        <translation>⚠ %1</translation>
    </message>
    <message>
        <source>Can be &amp;left out when the form is filled in</source>
        <translation>Kann beim Ausfüllen wegge&amp;lassen werden</translation>
    </message>
    <message>
        <source>Is &amp;ticked at first</source>
        <translation>&amp;Zu Beginn angekreuzt</translation>
    </message>
    <message>
        <source>Form:</source>
        <translation>Formular:</translation>
    </message>
</context>
<context>
    <name>plume::ChoiceBox</name>
    <message>
        <source>Other (%1)</source>
        <translation>Andere (%1)</translation>
    </message>
</context>
<context>
    <name>plume::ClipboardForm</name>
    <message>
        <source>Clipboard</source>
        <translation>Zwischenablage</translation>
    </message>
    <message>
        <source>&amp;Find:</source>
        <translation>&amp;Suchen:</translation>
    </message>
    <message>
        <source>&amp;Replace with:</source>
        <translation>&amp;Ersetzen durch:</translation>
    </message>
    <message>
        <source>Anywhere</source>
        <translation>Überall</translation>
    </message>
    <message>
        <source>At the start of words</source>
        <translation>Am Wortanfang</translation>
    </message>
    <message>
        <source>Whole words</source>
        <translation>Ganze Wörter</translation>
    </message>
    <message>
        <source>At the end of words</source>
        <translation>Am Wortende</translation>
    </message>
    <message>
        <source>Capitals and &amp;small letters differ</source>
        <translation>&amp;Groß- und Kleinschreibung beachten</translation>
    </message>
    <message>
        <source>Is a regular e&amp;xpression; $1 is its first group</source>
        <translation>Ist ein &amp;regulärer Ausdruck; $1 ist seine erste Gruppe</translation>
    </message>
    <message>
        <source>F&amp;ound:</source>
        <translation>Gef&amp;unden:</translation>
    </message>
    <message>
        <source>What is to be found is no valid pattern, or takes too long. The clipboard&apos;s text stays as it is.</source>
        <translation>Das Gesuchte ist kein gültiges Muster oder dauert zu lange. Der Text der Zwischenablage bleibt, wie er ist.</translation>
    </message>
    <message>
        <source>There is no text in the clipboard now.</source>
        <translation>In der Zwischenablage ist gerade kein Text.</translation>
    </message>
    <message>
        <source>Gives: %1</source>
        <translation>Ergibt: %1</translation>
    </message>
</context>
<context>
    <name>plume::ContentEdit</name>
    <message>
        <source>Ctrl+Tab types a tab.</source>
        <translation>Strg+Tab tippt einen Tabulator.</translation>
    </message>
    <message>
        <source>Cha&amp;nge…</source>
        <translation>Ä&amp;ndern…</translation>
    </message>
    <message>
        <source>Cu&amp;t</source>
        <translation>A&amp;usschneiden</translation>
    </message>
    <message>
        <source>&amp;Copy</source>
        <translation>&amp;Kopieren</translation>
    </message>
    <message>
        <source>&amp;Paste</source>
        <translation>&amp;Einfügen</translation>
    </message>
    <message>
        <source>Paste Without &amp;Formatting</source>
        <translation>Ohne &amp;Formatierung einfügen</translation>
    </message>
    <message>
        <source>Select &amp;All</source>
        <translation>&amp;Alles auswählen</translation>
    </message>
</context>
<context>
    <name>plume::ContentPane</name>
    <message>
        <source>&amp;Insert…</source>
        <translation>&amp;Einfügen…</translation>
    </message>
    <message>
        <source>Show So&amp;urce</source>
        <translation>&amp;Quelltext zeigen</translation>
    </message>
    <message>
        <source>Content</source>
        <translation>Inhalt</translation>
    </message>
    <message>
        <source>Script</source>
        <translation>Skript</translation>
    </message>
    <message>
        <source>Insert a date, a field, another snippet… (Ctrl+Space, or type 【)</source>
        <translation>Datum, Feld, anderes Snippet… einfügen (Strg+Leertaste oder 【 tippen)</translation>
    </message>
    <message>
        <source>Show placeholders as they are written (Ctrl+Shift+U)</source>
        <translation>Platzhalter zeigen, wie sie geschrieben sind (Strg+Umschalt+U)</translation>
    </message>
</context>
<context>
    <name>plume::DateForm</name>
    <message>
        <source>Date</source>
        <translation>Datum</translation>
    </message>
    <message>
        <source>From today</source>
        <translation>Von heute an</translation>
    </message>
    <message>
        <source>The next weekday of this name</source>
        <translation>Der nächste Wochentag dieses Namens</translation>
    </message>
    <message>
        <source>The last weekday of this name</source>
        <translation>Der letzte Wochentag dieses Namens</translation>
    </message>
    <message>
        <source>The last weekday of this name (%1)</source>
        <translation>Der letzte Wochentag dieses Namens (%1)</translation>
    </message>
    <message>
        <source>Years:</source>
        <translation>Jahre:</translation>
    </message>
    <message>
        <source>Years added</source>
        <translation>Addierte Jahre</translation>
    </message>
    <message>
        <source>Months:</source>
        <translation>Monate:</translation>
    </message>
    <message>
        <source>Months added</source>
        <translation>Addierte Monate</translation>
    </message>
    <message>
        <source>Days:</source>
        <translation>Tage:</translation>
    </message>
    <message>
        <source>Days added</source>
        <translation>Addierte Tage</translation>
    </message>
    <message>
        <source>Weekday %1</source>
        <translation>Wochentag %1</translation>
    </message>
    <message>
        <source>D&amp;ay:</source>
        <translation>&amp;Tag:</translation>
    </message>
    <message>
        <source>Added:</source>
        <translation>Addiert:</translation>
    </message>
    <message>
        <source>&amp;Weekday:</source>
        <translation>&amp;Wochentag:</translation>
    </message>
</context>
<context>
    <name>plume::DateTimeForm</name>
    <message>
        <source>Year</source>
        <translation>Jahr</translation>
    </message>
    <message>
        <source>Year, two digits</source>
        <translation>Jahr, zweistellig</translation>
    </message>
    <message>
        <source>Month</source>
        <translation>Monat</translation>
    </message>
    <message>
        <source>Month, two digits</source>
        <translation>Monat, zweistellig</translation>
    </message>
    <message>
        <source>Month, abbreviated</source>
        <translation>Monat, abgekürzt</translation>
    </message>
    <message>
        <source>Month, name</source>
        <translation>Monat, Name</translation>
    </message>
    <message>
        <source>Day</source>
        <translation>Tag</translation>
    </message>
    <message>
        <source>Day, two digits</source>
        <translation>Tag, zweistellig</translation>
    </message>
    <message>
        <source>Weekday, abbreviated</source>
        <translation>Wochentag, abgekürzt</translation>
    </message>
    <message>
        <source>Weekday, name</source>
        <translation>Wochentag, Name</translation>
    </message>
    <message>
        <source>Week of the year</source>
        <translation>Kalenderwoche</translation>
    </message>
    <message>
        <source>Day of the year</source>
        <translation>Tag des Jahres</translation>
    </message>
    <message>
        <source>Quarter</source>
        <translation>Quartal</translation>
    </message>
    <message>
        <source>Hour, 00 to 23</source>
        <translation>Stunde, 00 bis 23</translation>
    </message>
    <message>
        <source>Hour, 1 to 12</source>
        <translation>Stunde, 1 bis 12</translation>
    </message>
    <message>
        <source>Minute</source>
        <translation>Minute</translation>
    </message>
    <message>
        <source>Second</source>
        <translation>Sekunde</translation>
    </message>
    <message>
        <source>Half of the day</source>
        <translation>Tageshälfte</translation>
    </message>
    <message>
        <source>Time zone</source>
        <translation>Zeitzone</translation>
    </message>
    <message>
        <source>The pattern has letters without a meaning, so nothing is written. Put text between apostrophes.</source>
        <translation>Das Muster hat Buchstaben ohne Bedeutung, daher wird nichts geschrieben. Text zwischen Apostrophe setzen.</translation>
    </message>
    <message>
        <source>Gives: %1</source>
        <translation>Ergibt: %1</translation>
    </message>
    <message>
        <source>The pattern is empty.</source>
        <translation>Das Muster ist leer.</translation>
    </message>
    <message>
        <source>&amp;Style:</source>
        <translation>&amp;Stil:</translation>
    </message>
    <message>
        <source>&amp;Pattern:</source>
        <translation>&amp;Muster:</translation>
    </message>
    <message>
        <source>Pattern</source>
        <translation>Muster</translation>
    </message>
    <message>
        <source>Short: %1</source>
        <translation>Kurz: %1</translation>
    </message>
    <message>
        <source>Medium: %1</source>
        <translation>Mittel: %1</translation>
    </message>
    <message>
        <source>Long: %1</source>
        <translation>Lang: %1</translation>
    </message>
    <message>
        <source>Full: %1</source>
        <translation>Vollständig: %1</translation>
    </message>
    <message>
        <source>Own pattern</source>
        <translation>Eigenes Muster</translation>
    </message>
    <message>
        <source>Letters</source>
        <translation>Buchstaben</translation>
    </message>
    <message>
        <source>Letters of patterns</source>
        <translation>Buchstaben für Muster</translation>
    </message>
    <message>
        <source>What letters of a pattern stand for; choosing one puts it in</source>
        <translation>Wofür die Buchstaben eines Musters stehen; Wählen setzt sie ein</translation>
    </message>
    <message>
        <source>%1 (%2): %3</source>
        <translation>%1 (%2): %3</translation>
    </message>
    <message>
        <source>La&amp;nguage:</source>
        <translation>S&amp;prache:</translation>
    </message>
</context>
<context>
    <name>plume::DecisionsWindow</name>
    <message>
        <source>Why Didn&apos;t It Expand?</source>
        <translation>Warum wurde nichts ersetzt?</translation>
    </message>
    <message>
        <source>What became of the abbreviations that you typed last, the newest first. Plume remembers twenty of them until it ends, and nothing else of what you type.</source>
        <translation>Was aus den zuletzt getippten Kürzeln geworden ist, das neueste zuerst. Plume merkt sich zwanzig davon, bis es endet, und sonst nichts von dem, was getippt wird.</translation>
    </message>
    <message>
        <source>Abbreviations that you typed last</source>
        <translation>Zuletzt getippte Kürzel</translation>
    </message>
    <message>
        <source>Time</source>
        <translation>Zeit</translation>
    </message>
    <message>
        <source>Abbreviation</source>
        <translation>Kürzel</translation>
    </message>
    <message>
        <source>Group</source>
        <translation>Gruppe</translation>
    </message>
    <message>
        <source>What happened</source>
        <translation>Was geschah</translation>
    </message>
    <message>
        <source>Nothing to tell yet. Type an abbreviation in any program and come back: what became of it stands here then.</source>
        <translation>Noch gibt es nichts zu berichten. Was aus einem Kürzel geworden ist, das in einem Programm getippt wurde, steht danach hier.</translation>
    </message>
    <message>
        <source>&amp;Forget These</source>
        <translation>&amp;Vergessen</translation>
    </message>
    <message>
        <source>&amp;Refresh</source>
        <translation>&amp;Aktualisieren</translation>
    </message>
</context>
<context>
    <name>plume::DelimitersEdit</name>
    <message>
        <source>The usual ones</source>
        <translation>Die üblichen</translation>
    </message>
    <message>
        <source>%1 The usual ones</source>
        <translation>%1 Die üblichen</translation>
    </message>
    <message>
        <source>Space</source>
        <translation>Leerzeichen</translation>
    </message>
    <message>
        <source>Tab</source>
        <translation>Tab</translation>
    </message>
    <message>
        <source>Return</source>
        <translation>Eingabe</translation>
    </message>
    <message>
        <source>Enter</source>
        <translation>Enter</translation>
    </message>
    <message>
        <source>%1 %2</source>
        <translation>%1 %2</translation>
    </message>
    <message>
        <source>Others:</source>
        <translation>Andere:</translation>
    </message>
    <message>
        <source>%1 Others</source>
        <translation>%1 Andere</translation>
    </message>
    <message>
        <source>%1 characters</source>
        <translation>%1 Zeichen</translation>
    </message>
</context>
<context>
    <name>plume::DiagnosticWindow</name>
    <message>
        <source>Plume Diagnostics</source>
        <translation>Diagnose von Plume</translation>
    </message>
    <message>
        <source>Report</source>
        <translation>Bericht</translation>
    </message>
    <message>
        <source>&amp;Copy</source>
        <translation>&amp;Kopieren</translation>
    </message>
    <message>
        <source>&amp;Save…</source>
        <translation>&amp;Speichern…</translation>
    </message>
    <message>
        <source>This report says how Plume is doing. It holds none of your snippets and nothing that you typed.</source>
        <translation>Dieser Bericht sagt, wie es Plume geht. Er enthält keine Snippets und nichts Getipptes.</translation>
    </message>
    <message>
        <source>The report is on the clipboard.</source>
        <translation>Der Bericht ist in der Zwischenablage.</translation>
    </message>
    <message>
        <source>Save Report</source>
        <translation>Bericht speichern</translation>
    </message>
    <message>
        <source>Text files (*.txt)</source>
        <translation>Textdateien (*.txt)</translation>
    </message>
    <message>
        <source>Plume Report.txt</source>
        <translation>Plume-Bericht.txt</translation>
    </message>
    <message>
        <source>The report was saved.</source>
        <translation>Der Bericht wurde gespeichert.</translation>
    </message>
    <message>
        <source>The report was not saved</source>
        <translation>Der Bericht wurde nicht gespeichert</translation>
    </message>
</context>
<context>
    <name>plume::FieldControl</name>
    <message>
        <source>%1: %2</source>
        <comment>a field&apos;s name and value</comment>
        <translation>%1: %2</translation>
    </message>
</context>
<context>
    <name>plume::FieldForm</name>
    <message>
        <source>Field of the Form</source>
        <translation>Feld des Formulars</translation>
    </message>
    <message>
        <source>&amp;Name:</source>
        <translation>&amp;Name:</translation>
    </message>
    <message>
        <source>Cannot be &amp;edited in the form</source>
        <translation>Im Formular nicht zu &amp;bearbeiten</translation>
    </message>
    <message>
        <source>Text in one line</source>
        <translation>Text in einer Zeile</translation>
    </message>
    <message>
        <source>Text in several lines</source>
        <translation>Text in mehreren Zeilen</translation>
    </message>
    <message>
        <source>Menu to choose from</source>
        <translation>Menü zum Auswählen</translation>
    </message>
    <message>
        <source>Number, which can be calculated</source>
        <translation>Zahl, mit der gerechnet werden kann</translation>
    </message>
    <message>
        <source>Unknown kind %1</source>
        <translation>Unbekannte Art %1</translation>
    </message>
    <message>
        <source>&amp;Kind:</source>
        <translation>A&amp;rt:</translation>
    </message>
    <message>
        <source>&amp;Begins with:</source>
        <translation>B&amp;eginnt mit:</translation>
    </message>
    <message>
        <source>C&amp;hoices, one a line:</source>
        <translation>&amp;Möglichkeiten, eine je Zeile:</translation>
    </message>
    <message>
        <source>Chosen at f&amp;irst:</source>
        <translation>Zuerst ge&amp;wählt:</translation>
    </message>
    <message>
        <source>As usual</source>
        <translation>Wie üblich</translation>
    </message>
    <message>
        <source>&amp;Width in letters:</source>
        <translation>Breite &amp;in Zeichen:</translation>
    </message>
    <message>
        <source>Hei&amp;ght in lines:</source>
        <translation>&amp;Höhe in Zeilen:</translation>
    </message>
    <message>
        <source>Without a name the form does not say what is asked for.</source>
        <translation>Ohne Namen sagt das Formular nicht, wonach es fragt.</translation>
    </message>
    <message>
        <source>Gives: nothing</source>
        <translation>Ergibt: nichts</translation>
    </message>
    <message>
        <source>A menu without choices is not shown in the form.</source>
        <translation>Ein Menü ohne Auswahl wird im Formular nicht gezeigt.</translation>
    </message>
    <message>
        <source>Gives at first: %1</source>
        <translation>Ergibt zunächst: %1</translation>
    </message>
    <message>
        <source>Gives: what is typed in the form</source>
        <translation>Ergibt: was im Formular getippt wird</translation>
    </message>
</context>
<context>
    <name>plume::FilePanels</name>
    <message>
        <source>The snippets were not exported</source>
        <translation>Die Snippets wurden nicht exportiert</translation>
    </message>
    <message>
        <source>%1: snippets can be written to files that end with .plume, .csv or .json.</source>
        <translation>%1: Snippets lassen sich in Dateien schreiben, die auf .plume, .csv oder .json enden.</translation>
    </message>
    <message>
        <source>Import Snippets</source>
        <translation>Snippets importieren</translation>
    </message>
    <message>
        <source>Snippets of Plume and other programs (%1)</source>
        <translation>Snippets von Plume und anderen Programmen (%1)</translation>
    </message>
    <message>
        <source>All files (*)</source>
        <translation>Alle Dateien (*)</translation>
    </message>
    <message>
        <source>Choose</source>
        <translation>Auswählen</translation>
    </message>
    <message>
        <source>Plume library (*.plume)</source>
        <translation>Plume-Bibliothek (*.plume)</translation>
    </message>
    <message>
        <source>Comma-separated values (*.csv)</source>
        <translation>Kommagetrennte Werte (*.csv)</translation>
    </message>
    <message>
        <source>Readable library (*.json)</source>
        <translation>Lesbare Bibliothek (*.json)</translation>
    </message>
    <message>
        <source>Export Snippets</source>
        <translation>Snippets exportieren</translation>
    </message>
    <message>
        <source>Export</source>
        <translation>Exportieren</translation>
    </message>
    <message>
        <source>My Snippets</source>
        <translation>Meine Snippets</translation>
    </message>
</context>
<context>
    <name>plume::FileUseQuestion</name>
    <message>
        <source>Restore / Import data from %@</source>
        <translation>Daten aus %@ wiederherstellen oder importieren</translation>
    </message>
    <message>
        <source>Restoring will replace all current snippets with snippets from the selected file.<byte value="xd"/>
<byte value="xd"/>
Importing will add file&apos;s snippets to current snippets.</source>
        <translation>Wiederherstellen ersetzt alle jetzigen Snippets durch die der gewählten Datei.<byte value="xd"/>
<byte value="xd"/>
Importieren fügt die Snippets der Datei zu den jetzigen hinzu.</translation>
    </message>
    <message>
        <source>Import</source>
        <translation>Importieren</translation>
    </message>
    <message>
        <source>Restore</source>
        <translation>Wiederherstellen</translation>
    </message>
    <message>
        <source>Cancel</source>
        <translation>Abbrechen</translation>
    </message>
</context>
<context>
    <name>plume::FolderChoice</name>
    <message>
        <source>Default Directory</source>
        <translation>Standardordner</translation>
    </message>
    <message>
        <source>Other Folder…</source>
        <translation>Anderer Ordner…</translation>
    </message>
    <message>
        <source>Choose a folder</source>
        <translation>Ordner wählen</translation>
    </message>
    <message>
        <source>Another folder</source>
        <translation>Anderer Ordner</translation>
    </message>
    <message>
        <source>Choose a Folder</source>
        <translation>Ordner wählen</translation>
    </message>
</context>
<context>
    <name>plume::FormatBar</name>
    <message>
        <source>Red</source>
        <translation>Rot</translation>
    </message>
    <message>
        <source>Orange</source>
        <translation>Orange</translation>
    </message>
    <message>
        <source>Yellow</source>
        <translation>Gelb</translation>
    </message>
    <message>
        <source>Green</source>
        <translation>Grün</translation>
    </message>
    <message>
        <source>Blue</source>
        <translation>Blau</translation>
    </message>
    <message>
        <source>Purple</source>
        <translation>Violett</translation>
    </message>
    <message>
        <source>Gray</source>
        <translation>Grau</translation>
    </message>
    <message>
        <source>Format</source>
        <translation>Format</translation>
    </message>
    <message>
        <source>Font</source>
        <translation>Schriftart</translation>
    </message>
    <message>
        <source>Font size</source>
        <translation>Schriftgröße</translation>
    </message>
    <message>
        <source>Bold</source>
        <translation>Fett</translation>
    </message>
    <message>
        <source>B</source>
        <comment>sign for bold</comment>
        <translation>F</translation>
    </message>
    <message>
        <source>Italic</source>
        <translation>Kursiv</translation>
    </message>
    <message>
        <source>I</source>
        <comment>sign for italic</comment>
        <translation>K</translation>
    </message>
    <message>
        <source>Underline</source>
        <translation>Unterstrichen</translation>
    </message>
    <message>
        <source>U</source>
        <comment>sign for underline</comment>
        <translation>U</translation>
    </message>
    <message>
        <source>Strikethrough</source>
        <translation>Durchgestrichen</translation>
    </message>
    <message>
        <source>S</source>
        <comment>sign for strikethrough</comment>
        <translation>D</translation>
    </message>
    <message>
        <source>Text color</source>
        <translation>Textfarbe</translation>
    </message>
    <message>
        <source>Color</source>
        <translation>Farbe</translation>
    </message>
    <message>
        <source>Background color</source>
        <translation>Hintergrundfarbe</translation>
    </message>
    <message>
        <source>Marker</source>
        <translation>Marker</translation>
    </message>
    <message>
        <source>None</source>
        <comment>color</comment>
        <translation>Keine</translation>
    </message>
    <message>
        <source>Other…</source>
        <comment>color</comment>
        <translation>Andere…</translation>
    </message>
    <message>
        <source>Bulleted list</source>
        <translation>Aufzählung</translation>
    </message>
    <message>
        <source>Numbered list</source>
        <translation>Nummerierte Liste</translation>
    </message>
    <message>
        <source>Alignment</source>
        <translation>Ausrichtung</translation>
    </message>
    <message>
        <source>Align</source>
        <translation>Ausrichten</translation>
    </message>
    <message>
        <source>Left</source>
        <translation>Linksbündig</translation>
    </message>
    <message>
        <source>Right</source>
        <translation>Rechtsbündig</translation>
    </message>
    <message>
        <source>Centered</source>
        <translation>Zentriert</translation>
    </message>
    <message>
        <source>Justified</source>
        <translation>Blocksatz</translation>
    </message>
    <message>
        <source>Link…</source>
        <translation>Link…</translation>
    </message>
    <message>
        <source>Link</source>
        <translation>Link</translation>
    </message>
    <message>
        <source>Picture…</source>
        <translation>Bild…</translation>
    </message>
    <message>
        <source>Picture</source>
        <translation>Bild</translation>
    </message>
    <message>
        <source>Clear formatting</source>
        <translation>Formatierung löschen</translation>
    </message>
    <message>
        <source>Clear</source>
        <translation>Löschen</translation>
    </message>
    <message>
        <source>Address (empty for no link):</source>
        <translation>Adresse (leer für keinen Link):</translation>
    </message>
    <message>
        <source>Pictures (*.png *.jpg *.jpeg *.gif *.bmp *.webp *.svg)</source>
        <translation>Bilder (*.png *.jpg *.jpeg *.gif *.bmp *.webp *.svg)</translation>
    </message>
    <message>
        <source>The picture cannot be inserted.</source>
        <translation>Das Bild lässt sich nicht einfügen.</translation>
    </message>
    <message>
        <source>Pictures may have up to 16 MB.</source>
        <translation>Bilder dürfen bis zu 16 MB groß sein.</translation>
    </message>
    <message>
        <source>The file cannot be read as a picture.</source>
        <translation>Die Datei lässt sich nicht als Bild lesen.</translation>
    </message>
</context>
<context>
    <name>plume::GroupEditor</name>
    <message>
        <source>Enabled</source>
        <translation>Eingeschaltet</translation>
    </message>
    <message>
        <source>Ignored</source>
        <translation>Ignoriert</translation>
    </message>
    <message>
        <source>Name:</source>
        <translation>Name:</translation>
    </message>
    <message>
        <source>Optional: typed before every abbreviation</source>
        <translation>Optional: vor jedem Kürzel getippt</translation>
    </message>
    <message>
        <source>Prefix:</source>
        <translation>Präfix:</translation>
    </message>
    <message>
        <source>Expansion</source>
        <translation>Ersetzen</translation>
    </message>
    <message>
        <source>Expands behind:</source>
        <translation>Ersetzt hinter:</translation>
    </message>
    <message>
        <source>A delimiter</source>
        <translation>Einem Trennzeichen</translation>
    </message>
    <message>
        <source>White space</source>
        <translation>Leerraum</translation>
    </message>
    <message>
        <source>Anything, even a letter</source>
        <translation>Allem, auch einem Buchstaben</translation>
    </message>
    <message>
        <source>A number</source>
        <translation>Einer Zahl</translation>
    </message>
    <message>
        <source>Delimiters before it:</source>
        <translation>Trennzeichen davor:</translation>
    </message>
    <message>
        <source>Expands:</source>
        <translation>Ersetzt:</translation>
    </message>
    <message>
        <source>At once, with its last character</source>
        <translation>Sofort, mit dem letzten Zeichen</translation>
    </message>
    <message>
        <source>With a delimiter, which stays</source>
        <translation>Mit einem Trennzeichen, das bleibt</translation>
    </message>
    <message>
        <source>With a delimiter, which is left out</source>
        <translation>Mit einem Trennzeichen, das entfällt</translation>
    </message>
    <message>
        <source>Never by typing</source>
        <translation>Nie durch Tippen</translation>
    </message>
    <message>
        <source>With the hot key that expands</source>
        <translation>Mit dem Tastenkürzel zum Ersetzen</translation>
    </message>
    <message>
        <source>Delimiters behind it:</source>
        <translation>Trennzeichen dahinter:</translation>
    </message>
    <message>
        <source>Offer as suggestions</source>
        <translation>Als Vorschläge anbieten</translation>
    </message>
    <message>
        <source>List in the menu</source>
        <translation>Im Menü aufführen</translation>
    </message>
    <message>
        <source>Reset the formatting behind a formatted text</source>
        <translation>Formatierung hinter formatiertem Text zurücksetzen</translation>
    </message>
    <message>
        <source>Letter case</source>
        <translation>Groß-/Kleinschreibung</translation>
    </message>
    <message>
        <source>New snippets:</source>
        <translation>Neue Snippets:</translation>
    </message>
    <message>
        <source>Letter case of new snippets</source>
        <translation>Groß-/Kleinschreibung neuer Snippets</translation>
    </message>
    <message>
        <source>Reset…</source>
        <translation>Zurücksetzen…</translation>
    </message>
    <message>
        <source>Reset the letter case of all snippets</source>
        <translation>Groß-/Kleinschreibung aller Snippets zurücksetzen</translation>
    </message>
    <message>
        <source>All snippets:</source>
        <translation>Alle Snippets:</translation>
    </message>
    <message>
        <source>Where</source>
        <translation>Wo</translation>
    </message>
    <message>
        <source>Programs:</source>
        <translation>Programme:</translation>
    </message>
    <message>
        <source>In all programs</source>
        <translation>In allen Programmen</translation>
    </message>
    <message>
        <source>In all programs except those below</source>
        <translation>In allen Programmen außer den folgenden</translation>
    </message>
    <message>
        <source>Only in the programs below</source>
        <translation>Nur in den folgenden Programmen</translation>
    </message>
    <message>
        <source>Keyboard layouts:</source>
        <translation>Tastaturbelegungen:</translation>
    </message>
</context>
<context>
    <name>plume::HotKeyRecorder</name>
    <message>
        <source>Ctrl</source>
        <translation>Strg</translation>
    </message>
    <message>
        <source>Alt</source>
        <translation>Alt</translation>
    </message>
    <message>
        <source>Shift</source>
        <translation>Umschalt</translation>
    </message>
    <message>
        <source>Super</source>
        <translation>Super</translation>
    </message>
    <message>
        <source>Key %1</source>
        <translation>Taste %1</translation>
    </message>
    <message>
        <source>Clear</source>
        <translation>Löschen</translation>
    </message>
    <message>
        <source>Nothing was heard. Plume may not hear the keyboard at the moment.</source>
        <translation>Es war nichts zu hören. Vielleicht hört Plume die Tastatur gerade nicht.</translation>
    </message>
    <message>
        <source>Clear the hot key: %1</source>
        <translation>Tastenkürzel löschen: %1</translation>
    </message>
    <message>
        <source>%1 would be typed all the time. Hold Ctrl, Alt or Super with it.</source>
        <translation>%1 würde ständig getippt. Bitte Strg, Alt oder Super dazu halten.</translation>
    </message>
    <message>
        <source>%1 is the hot key of “%2” already.</source>
        <translation>%1 ist schon das Tastenkürzel für „%2“.</translation>
    </message>
    <message>
        <source>Press keys… Escape leaves it as it is</source>
        <translation>Tasten drücken… Esc bricht ab</translation>
    </message>
    <message>
        <source>None</source>
        <translation>Keines</translation>
    </message>
</context>
<context>
    <name>plume::ImportModel</name>
    <message>
        <source>No snippets</source>
        <translation>Keine Snippets</translation>
    </message>
    <message>
        <source>1 snippet</source>
        <translation>1 Snippet</translation>
    </message>
    <message numerus="yes">
        <source>%n snippets</source>
        <translation>
            <numerusform>%n Snippet</numerusform>
            <numerusform>%n Snippets</numerusform>
        </translation>
    </message>
    <message>
        <source>Group, Abbreviation</source>
        <translation>Gruppe, Kürzel</translation>
    </message>
    <message>
        <source>Content</source>
        <translation>Inhalt</translation>
    </message>
    <message>
        <source>In Your Library</source>
        <translation>In der eigenen Bibliothek</translation>
    </message>
    <message>
        <source>Takes the place of your group of this name</source>
        <translation>Tritt an die Stelle der eigenen Gruppe dieses Namens</translation>
    </message>
    <message>
        <source>All of it is there already</source>
        <translation>Alles davon ist schon da</translation>
    </message>
    <message>
        <source>1 is there already</source>
        <translation>1 ist schon da</translation>
    </message>
    <message numerus="yes">
        <source>%n are there already</source>
        <translation>
            <numerusform>%n ist schon da</numerusform>
            <numerusform>%n sind schon da</numerusform>
        </translation>
    </message>
    <message>
        <source>1 abbreviation is taken</source>
        <translation>1 Kürzel ist vergeben</translation>
    </message>
    <message numerus="yes">
        <source>%n abbreviations are taken</source>
        <translation>
            <numerusform>%n Kürzel ist vergeben</numerusform>
            <numerusform>%n Kürzel sind vergeben</numerusform>
        </translation>
    </message>
    <message>
        <source>Comes twice, also in “%1”</source>
        <translation>Kommt doppelt vor, auch in „%1“</translation>
    </message>
    <message>
        <source>Is there already, in “%1”</source>
        <translation>Ist schon da, in „%1“</translation>
    </message>
    <message>
        <source>Is taken by another one in “%1”</source>
        <translation>Ist durch ein anderes in „%1“ vergeben</translation>
    </message>
</context>
<context>
    <name>plume::ImportWindow</name>
    <message>
        <source>Convert the &amp;placeholders of TextExpander</source>
        <translation>&amp;Platzhalter von TextExpander umwandeln</translation>
    </message>
    <message>
        <source>What cannot be carried over &amp;whole:</source>
        <translation>Was sich nicht &amp;ganz übernehmen lässt:</translation>
    </message>
    <message>
        <source>Import Snippets</source>
        <translation>Snippets importieren</translation>
    </message>
    <message>
        <source>Groups and snippets in the file</source>
        <translation>Gruppen und Snippets in der Datei</translation>
    </message>
    <message>
        <source>What cannot be carried over whole</source>
        <translation>Was sich nicht ganz übernehmen lässt</translation>
    </message>
    <message>
        <source>Reading</source>
        <translation>Lesen</translation>
    </message>
    <message>
        <source>&amp;Import</source>
        <translation>&amp;Importieren</translation>
    </message>
    <message>
        <source>Cancel</source>
        <translation>Abbrechen</translation>
    </message>
    <message>
        <source>Reading “%1”…</source>
        <translation>„%1“ wird gelesen…</translation>
    </message>
    <message>
        <source>Nothing can be imported from “%1”</source>
        <translation>Aus „%1“ lässt sich nichts importieren</translation>
    </message>
    <message>
        <source>There are no snippets in “%1”</source>
        <translation>In „%1“ sind keine Snippets</translation>
    </message>
    <message>
        <source>Close</source>
        <translation>Schließen</translation>
    </message>
    <message>
        <source>in 1 group</source>
        <translation>in 1 Gruppe</translation>
    </message>
    <message numerus="yes">
        <source>in %n groups</source>
        <translation>
            <numerusform>in %n Gruppe</numerusform>
            <numerusform>in %n Gruppen</numerusform>
        </translation>
    </message>
    <message>
        <source>1 snippet</source>
        <translation>1 Snippet</translation>
    </message>
    <message numerus="yes">
        <source>%n snippets</source>
        <translation>
            <numerusform>%n Snippet</numerusform>
            <numerusform>%n Snippets</numerusform>
        </translation>
    </message>
    <message>
        <source>“%1”: %2 %3</source>
        <extracomment>The file&apos;s name, &quot;12 snippets&quot;, &quot;in 2 groups&quot;.</extracomment>
        <translation>„%1“: %2 %3</translation>
    </message>
    <message>
        <source>&amp;Import 1 Group</source>
        <translation>1 Gruppe &amp;importieren</translation>
    </message>
    <message numerus="yes">
        <source>&amp;Import %n Groups</source>
        <translation>
            <numerusform>%n Gruppe &amp;importieren</numerusform>
            <numerusform>%n Gruppen &amp;importieren</numerusform>
        </translation>
    </message>
</context>
<context>
    <name>plume::InitalSyncWindowController</name>
    <message>
        <source>Synchronize Snippets</source>
        <translation>Snippets abgleichen</translation>
    </message>
    <message>
        <source>Use the snippets in “%@” on this computer</source>
        <translation>Die Snippets in „%@“ auf diesem Computer verwenden</translation>
    </message>
    <message>
        <source>Replace the snippets in “%@” by those of this computer</source>
        <translation>Die Snippets in „%@“ durch die dieses Computers ersetzen</translation>
    </message>
    <message>
        <source>The folder “%@” holds snippets already</source>
        <translation>Der Ordner „%@“ enthält schon Snippets</translation>
    </message>
    <message>
        <source>&amp;Cancel</source>
        <translation>&amp;Abbrechen</translation>
    </message>
    <message>
        <source>Which snippets do you want to keep?</source>
        <translation>Welche Snippets sollen bleiben?</translation>
    </message>
    <message>
        <source>The snippets that are replaced are not lost: Plume writes a backup of them first.</source>
        <translation>Die ersetzten Snippets gehen nicht verloren: Plume sichert sie zuvor.</translation>
    </message>
    <message>
        <source>&amp;Use Folder’s Snippets</source>
        <translation>Snippets des Ordners &amp;verwenden</translation>
    </message>
    <message>
        <source>&amp;Replace Folder’s Snippets</source>
        <translation>Snippets des Ordners &amp;ersetzen</translation>
    </message>
</context>
<context>
    <name>plume::InputSourcesEdit</name>
    <message>
        <source>With all layouts</source>
        <translation>Bei allen Belegungen</translation>
    </message>
    <message>
        <source>With all layouts except those checked below</source>
        <translation>Bei allen Belegungen außer den unten angekreuzten</translation>
    </message>
    <message>
        <source>Only with the layouts checked below</source>
        <translation>Nur bei den unten angekreuzten Belegungen</translation>
    </message>
    <message>
        <source>Keyboard layouts</source>
        <translation>Tastaturbelegungen</translation>
    </message>
    <message>
        <source>Chosen keyboard layouts</source>
        <translation>Gewählte Tastaturbelegungen</translation>
    </message>
    <message>
        <source>Another layout</source>
        <translation>Andere Belegung</translation>
    </message>
    <message>
        <source>Another layout, like “de(nodeadkeys)”</source>
        <translation>Andere Belegung, etwa „de(nodeadkeys)“</translation>
    </message>
    <message>
        <source>Add Layout</source>
        <translation>Belegung hinzufügen</translation>
    </message>
</context>
<context>
    <name>plume::InsertMenu</name>
    <message>
        <source>Nothing was found.</source>
        <translation>Nichts gefunden.</translation>
    </message>
    <message>
        <source>Insert</source>
        <translation>Einfügen</translation>
    </message>
    <message>
        <source>Search what to insert</source>
        <translation>Suchen, was eingefügt werden soll</translation>
    </message>
    <message>
        <source>What can be inserted</source>
        <translation>Was sich einfügen lässt</translation>
    </message>
</context>
<context>
    <name>plume::KeyForm</name>
    <message>
        <source>Return</source>
        <translation>Eingabe</translation>
    </message>
    <message>
        <source>Tab</source>
        <translation>Tab</translation>
    </message>
    <message>
        <source>Escape</source>
        <translation>Escape</translation>
    </message>
    <message>
        <source>Space</source>
        <translation>Leertaste</translation>
    </message>
    <message>
        <source>Backspace</source>
        <translation>Rücktaste</translation>
    </message>
    <message>
        <source>Delete</source>
        <translation>Entf</translation>
    </message>
    <message>
        <source>Left</source>
        <translation>Pfeil links</translation>
    </message>
    <message>
        <source>Right</source>
        <translation>Pfeil rechts</translation>
    </message>
    <message>
        <source>Up</source>
        <translation>Pfeil auf</translation>
    </message>
    <message>
        <source>Down</source>
        <translation>Pfeil ab</translation>
    </message>
    <message>
        <source>Home</source>
        <translation>Pos1</translation>
    </message>
    <message>
        <source>End</source>
        <translation>Ende</translation>
    </message>
    <message>
        <source>Page Up</source>
        <translation>Bild auf</translation>
    </message>
    <message>
        <source>Page Down</source>
        <translation>Bild ab</translation>
    </message>
    <message>
        <source>Enter of the keypad</source>
        <translation>Enter des Ziffernblocks</translation>
    </message>
    <message>
        <source>Insert</source>
        <translation>Einfg</translation>
    </message>
    <message>
        <source>Key</source>
        <translation>Taste</translation>
    </message>
    <message>
        <source>Nothing was heard. Plume may not hear the keyboard at the moment.</source>
        <translation>Nichts wurde gehört. Vielleicht hört Plume die Tastatur gerade nicht.</translation>
    </message>
    <message>
        <source>No key</source>
        <translation>Keine Taste</translation>
    </message>
    <message>
        <source>Key %1</source>
        <translation>Taste %1</translation>
    </message>
    <message>
        <source>&amp;Record</source>
        <translation>Auf&amp;nehmen</translation>
    </message>
    <message>
        <source>Takes the next key that is pressed</source>
        <translation>Nimmt die nächste Taste, die gedrückt wird</translation>
    </message>
    <message>
        <source>&amp;Key:</source>
        <translation>&amp;Taste:</translation>
    </message>
    <message>
        <source>Held with it:</source>
        <translation>Dazu gehalten:</translation>
    </message>
    <message>
        <source>Ctr&amp;l</source>
        <translation>&amp;Strg</translation>
    </message>
    <message>
        <source>&amp;Alt</source>
        <translation>A&amp;lt</translation>
    </message>
    <message>
        <source>&amp;Shift</source>
        <translation>&amp;Umschalt</translation>
    </message>
    <message>
        <source>S&amp;uper</source>
        <translation>Su&amp;per</translation>
    </message>
    <message>
        <source>Not at all</source>
        <translation>Gar nicht</translation>
    </message>
    <message>
        <source>seconds</source>
        <translation>Sekunden</translation>
    </message>
    <message>
        <source>&amp;Times pressed:</source>
        <translation>Wie &amp;oft gedrückt:</translation>
    </message>
    <message>
        <source>&amp;Waits before:</source>
        <translation>&amp;Wartet davor:</translation>
    </message>
    <message>
        <source>Presses no key.</source>
        <translation>Drückt keine Taste.</translation>
    </message>
    <message>
        <source>Presses %1</source>
        <translation>Drückt %1</translation>
    </message>
    <message>
        <source>%1, %2 times</source>
        <translation>%1, %2-mal</translation>
    </message>
    <message>
        <source>%1, after %2 seconds</source>
        <translation>%1, nach %2 Sekunden</translation>
    </message>
    <message>
        <source>Press a key… (Escape ends)</source>
        <translation>Eine Taste drücken… (Escape beendet)</translation>
    </message>
</context>
<context>
    <name>plume::LibraryExportWindow</name>
    <message>
        <source>Plume library (*.plume)</source>
        <translation>Plume-Bibliothek (*.plume)</translation>
    </message>
    <message>
        <source>Comma-separated values (*.csv)</source>
        <translation>Kommagetrennte Werte (*.csv)</translation>
    </message>
    <message>
        <source>Readable library (*.json)</source>
        <translation>Lesbare Bibliothek (*.json)</translation>
    </message>
    <message>
        <source>Rich text, to read and print (*.rtf)</source>
        <translation>Formatierter Text zum Lesen und Drucken (*.rtf)</translation>
    </message>
    <message>
        <source>Export</source>
        <translation>Exportieren</translation>
    </message>
    <message>
        <source>The snippets were not exported</source>
        <translation>Die Snippets wurden nicht exportiert</translation>
    </message>
    <message>
        <source>Export All Snippets</source>
        <translation>Alle Snippets exportieren</translation>
    </message>
    <message>
        <source>My Snippets</source>
        <translation>Meine Snippets</translation>
    </message>
    <message>
        <source>Export the Group “%1”</source>
        <translation>Gruppe „%1“ exportieren</translation>
    </message>
    <message>
        <source>Export the Selected Snippets</source>
        <translation>Ausgewählte Snippets exportieren</translation>
    </message>
    <message>
        <source>Selected Snippets</source>
        <translation>Ausgewählte Snippets</translation>
    </message>
</context>
<context>
    <name>plume::LocaleChoice</name>
    <message>
        <source>Yours</source>
        <translation>Eigene</translation>
    </message>
</context>
<context>
    <name>plume::MacrosWindowController</name>
    <message>
        <source>&amp;File</source>
        <translation>&amp;Datei</translation>
    </message>
    <message>
        <source>&amp;Edit</source>
        <translation>&amp;Bearbeiten</translation>
    </message>
    <message>
        <source>&amp;Library</source>
        <translation>Bib&amp;liothek</translation>
    </message>
    <message>
        <source>&amp;New Snippet</source>
        <translation>&amp;Neues Snippet</translation>
    </message>
    <message>
        <source>New Snippet from Clip&amp;board</source>
        <translation>Neues Snippet aus der &amp;Zwischenablage</translation>
    </message>
    <message>
        <source>New &amp;Group</source>
        <translation>Neue &amp;Gruppe</translation>
    </message>
    <message>
        <source>&amp;Import…</source>
        <translation>&amp;Importieren…</translation>
    </message>
    <message>
        <source>&amp;Export</source>
        <translation>&amp;Exportieren</translation>
    </message>
    <message>
        <source>&amp;Preferences…</source>
        <translation>Einste&amp;llungen…</translation>
    </message>
    <message>
        <source>&amp;Close</source>
        <translation>&amp;Schließen</translation>
    </message>
    <message>
        <source>&amp;Quit Plume</source>
        <translation>Plume &amp;beenden</translation>
    </message>
    <message>
        <source>&amp;Undo %1</source>
        <translation>&amp;Rückgängig: %1</translation>
    </message>
    <message>
        <source>&amp;Undo</source>
        <translation>&amp;Rückgängig</translation>
    </message>
    <message>
        <source>&amp;Redo %1</source>
        <translation>&amp;Wiederholen: %1</translation>
    </message>
    <message>
        <source>&amp;Redo</source>
        <translation>&amp;Wiederholen</translation>
    </message>
    <message>
        <source>Cu&amp;t</source>
        <translation>A&amp;usschneiden</translation>
    </message>
    <message>
        <source>&amp;Copy</source>
        <translation>&amp;Kopieren</translation>
    </message>
    <message>
        <source>&amp;Paste</source>
        <translation>&amp;Einfügen</translation>
    </message>
    <message>
        <source>Select &amp;All</source>
        <translation>&amp;Alles auswählen</translation>
    </message>
    <message>
        <source>&amp;Duplicate</source>
        <translation>&amp;Duplizieren</translation>
    </message>
    <message>
        <source>De&amp;lete</source>
        <translation>&amp;Löschen</translation>
    </message>
    <message>
        <source>Rena&amp;me</source>
        <translation>U&amp;mbenennen</translation>
    </message>
    <message>
        <source>&amp;Find</source>
        <translation>&amp;Suchen</translation>
    </message>
    <message>
        <source>&amp;Sort Snippets</source>
        <translation>&amp;Snippets sortieren</translation>
    </message>
    <message>
        <source>Sort &amp;Groups</source>
        <translation>&amp;Gruppen sortieren</translation>
    </message>
    <message>
        <source>&amp;Add</source>
        <translation>&amp;Hinzufügen</translation>
    </message>
    <message>
        <source>&amp;Delete Duplicated Snippets…</source>
        <translation>&amp;Doppelte Snippets löschen…</translation>
    </message>
    <message>
        <source>&amp;None</source>
        <translation>&amp;Unsortiert</translation>
    </message>
    <message>
        <source>By &amp;Abbreviation</source>
        <translation>Nach &amp;Kürzel</translation>
    </message>
    <message>
        <source>By &amp;Label or Content</source>
        <translation>Nach &amp;Bezeichnung oder Inhalt</translation>
    </message>
    <message>
        <source>By Date &amp;Created</source>
        <translation>Nach &amp;Erstelldatum</translation>
    </message>
    <message>
        <source>By Date C&amp;hanged</source>
        <translation>Nach Änderungs&amp;datum</translation>
    </message>
    <message>
        <source>By Last &amp;Use</source>
        <translation>Nach &amp;letzter Benutzung</translation>
    </message>
    <message>
        <source>AutoCorrect Dictionary (%1)</source>
        <translation>AutoKorrektur-Wörterbuch (%1)</translation>
    </message>
    <message>
        <source>&amp;Selection…</source>
        <translation>&amp;Auswahl…</translation>
    </message>
    <message>
        <source>&amp;Group…</source>
        <translation>&amp;Gruppe…</translation>
    </message>
    <message>
        <source>&amp;All Groups…</source>
        <translation>A&amp;lle Gruppen…</translation>
    </message>
    <message>
        <source>Nothing was added.</source>
        <translation>Nichts wurde hinzugefügt.</translation>
    </message>
    <message>
        <source>My Snippets</source>
        <translation>Meine Snippets</translation>
    </message>
    <message>
        <source>New Group</source>
        <translation>Neue Gruppe</translation>
    </message>
    <message>
        <source>There are no duplicated snippets.</source>
        <translation>Es gibt keine doppelten Snippets.</translation>
    </message>
    <message>
        <source>Duplicated are snippets with the same abbreviation and the same content.</source>
        <translation>Doppelt sind Snippets mit demselben Kürzel und demselben Inhalt.</translation>
    </message>
    <message>
        <source>Are you sure you want to delete all (#) duplicated snippets?</source>
        <translation>Wirklich alle (#) doppelten Snippets löschen?</translation>
    </message>
    <message>
        <source>One of each stays. Undo brings them back as long as this window is open.</source>
        <translation>Je eines bleibt. Rückgängig holt sie zurück, solange dieses Fenster offen ist.</translation>
    </message>
    <message>
        <source>Delete</source>
        <translation>Löschen</translation>
    </message>
    <message>
        <source>What the clipboard has could not be read: %1</source>
        <translation>Der Inhalt der Zwischenablage ließ sich nicht lesen: %1</translation>
    </message>
    <message>
        <source>Snippets</source>
        <translation>Snippets</translation>
    </message>
    <message>
        <source>Notice</source>
        <translation>Hinweis</translation>
    </message>
    <message>
        <source>This snippet is no longer in the library.</source>
        <translation>Dieses Snippet ist nicht mehr in der Bibliothek.</translation>
    </message>
    <message>
        <source>There are no snippets yet. Choose New Snippet in the menu File, or press Ctrl+N.</source>
        <translation>Es gibt noch keine Snippets. Im Menü „Datei“ den Eintrag „Neues Snippet“ wählen oder Strg+N drücken.</translation>
    </message>
    <message>
        <source>Select a snippet to see and change it.</source>
        <translation>Ein Snippet auswählen, um es zu sehen und zu ändern.</translation>
    </message>
    <message>
        <source>Several rows are selected: they can be moved, copied, duplicated and deleted.</source>
        <translation>Mehrere Zeilen sind ausgewählt: Sie lassen sich verschieben, kopieren, duplizieren und löschen.</translation>
    </message>
    <message>
        <source>Your snippets were changed elsewhere meanwhile: this can no longer be undone.</source>
        <translation>Die Snippets wurden inzwischen anderswo geändert: Dies lässt sich nicht mehr rückgängig machen.</translation>
    </message>
    <message>
        <source>Your snippets were changed elsewhere and are shown as they are now.</source>
        <translation>Die Snippets wurden anderswo geändert und werden gezeigt, wie sie jetzt sind.</translation>
    </message>
    <message>
        <source>Your snippets were changed elsewhere. What you were just editing was kept.</source>
        <translation>Die Snippets wurden anderswo geändert. Was gerade bearbeitet wurde, blieb erhalten.</translation>
    </message>
</context>
<context>
    <name>plume::Messages</name>
    <message>
        <source>OK</source>
        <translation>OK</translation>
    </message>
    <message>
        <source>Cancel</source>
        <translation>Abbrechen</translation>
    </message>
</context>
<context>
    <name>plume::NewSnippetWindow</name>
    <message>
        <source>New Snippet</source>
        <translation>Neues Snippet</translation>
    </message>
    <message>
        <source>My Snippets</source>
        <translation>Meine Snippets</translation>
    </message>
    <message>
        <source>Add &amp;Snippet</source>
        <translation>Snippet &amp;hinzufügen</translation>
    </message>
    <message>
        <source>&amp;Cancel</source>
        <translation>&amp;Abbrechen</translation>
    </message>
    <message>
        <source>Optional: a name for lists</source>
        <translation>Optional: ein Name für Listen</translation>
    </message>
    <message>
        <source>About the abbreviation</source>
        <translation>Zum Kürzel</translation>
    </message>
    <message>
        <source>&amp;Group:</source>
        <translation>&amp;Gruppe:</translation>
    </message>
    <message>
        <source>Na&amp;me of group:</source>
        <translation>&amp;Name der Gruppe:</translation>
    </message>
    <message>
        <source>&amp;Abbreviation:</source>
        <translation>&amp;Kürzel:</translation>
    </message>
    <message>
        <source>&amp;Label:</source>
        <translation>&amp;Bezeichnung:</translation>
    </message>
    <message>
        <source>&amp;Text:</source>
        <translation>&amp;Text:</translation>
    </message>
    <message>
        <source>Untitled group</source>
        <translation>Unbenannte Gruppe</translation>
    </message>
    <message>
        <source>New Group…</source>
        <translation>Neue Gruppe…</translation>
    </message>
    <message>
        <source>Without an abbreviation it can only be chosen from lists.</source>
        <translation>Ohne Kürzel lässt es sich nur aus Listen wählen.</translation>
    </message>
    <message>
        <source>The group has this abbreviation already. Both will be kept.</source>
        <translation>Die Gruppe hat es schon. Beide bleiben erhalten.</translation>
    </message>
    <message>
        <source>Do you want to throw this snippet away?</source>
        <translation>Dieses Snippet verwerfen?</translation>
    </message>
    <message>
        <source>It was not added to your snippets yet.</source>
        <translation>Es wurde noch nicht zu den Snippets hinzugefügt.</translation>
    </message>
    <message>
        <source>Throw Away</source>
        <translation>Verwerfen</translation>
    </message>
</context>
<context>
    <name>plume::OutlineModel</name>
    <message>
        <source>Untitled group</source>
        <translation>Unbenannte Gruppe</translation>
    </message>
    <message>
        <source>Off</source>
        <translation>Aus</translation>
    </message>
    <message>
        <source>Duplicate</source>
        <translation>Doppelt</translation>
    </message>
    <message>
        <source>Script</source>
        <translation>Skript</translation>
    </message>
    <message>
        <source>Formatted</source>
        <translation>Formatiert</translation>
    </message>
</context>
<context>
    <name>plume::OutlinePane</name>
    <message>
        <source>&amp;Search By</source>
        <translation>Suchen &amp;nach</translation>
    </message>
    <message>
        <source>Nothing was found.</source>
        <translation>Nichts gefunden.</translation>
    </message>
    <message>
        <source>Search</source>
        <translation>Suchen</translation>
    </message>
    <message>
        <source>Search in the snippets</source>
        <translation>In den Snippets suchen</translation>
    </message>
    <message>
        <source>What is searched</source>
        <translation>Was durchsucht wird</translation>
    </message>
    <message>
        <source>&amp;Abbreviation</source>
        <translation>&amp;Kürzel</translation>
    </message>
    <message>
        <source>&amp;Label</source>
        <translation>&amp;Bezeichnung</translation>
    </message>
    <message>
        <source>&amp;Content</source>
        <translation>&amp;Inhalt</translation>
    </message>
    <message>
        <source>&amp;Wildcards: * and ?</source>
        <translation>&amp;Platzhalter: * und ?</translation>
    </message>
</context>
<context>
    <name>plume::OutlineView</name>
    <message>
        <source>Groups and snippets</source>
        <translation>Gruppen und Snippets</translation>
    </message>
</context>
<context>
    <name>plume::PlainFormWindow</name>
    <message>
        <source>Text of the snippet</source>
        <translation>Text des Snippets</translation>
    </message>
    <message>
        <source>Field %1</source>
        <translation>Feld %1</translation>
    </message>
</context>
<context>
    <name>plume::PreferencesPage</name>
    <message>
        <source>This could not be kept. %1</source>
        <translation>Das ließ sich nicht speichern. %1</translation>
    </message>
    <message>
        <source>Another value (%1)</source>
        <translation>Anderer Wert (%1)</translation>
    </message>
    <message>
        <source> seconds</source>
        <translation> Sekunden</translation>
    </message>
    <message>
        <source>In all programs</source>
        <translation>In allen Programmen</translation>
    </message>
    <message>
        <source>In all programs except those below</source>
        <translation>In allen Programmen außer den folgenden</translation>
    </message>
    <message>
        <source>Only in the programs below</source>
        <translation>Nur in den folgenden Programmen</translation>
    </message>
    <message>
        <source>Programs</source>
        <translation>Programme</translation>
    </message>
    <message>
        <source>Enabled</source>
        <translation>Eingeschlossen</translation>
    </message>
    <message>
        <source>Ignored</source>
        <translation>Ausgenommen</translation>
    </message>
</context>
<context>
    <name>plume::PreferencesWindow</name>
    <message>
        <source>Preferences</source>
        <translation>Einstellungen</translation>
    </message>
    <message>
        <source>General</source>
        <translation>Allgemein</translation>
    </message>
    <message>
        <source>Expansion</source>
        <translation>Ersetzen</translation>
    </message>
    <message>
        <source>Suggestions and search</source>
        <translation>Vorschläge und Suche</translation>
    </message>
    <message>
        <source>Typing and clipboard</source>
        <translation>Tippen und Zwischenablage</translation>
    </message>
    <message>
        <source>Correction</source>
        <translation>Korrektur</translation>
    </message>
    <message>
        <source>Hot keys</source>
        <translation>Tastenkürzel</translation>
    </message>
    <message>
        <source>Applications</source>
        <translation>Programme</translation>
    </message>
    <message>
        <source>Backups and sync</source>
        <translation>Sicherung und Abgleich</translation>
    </message>
    <message>
        <source>Import and export</source>
        <translation>Import und Export</translation>
    </message>
    <message>
        <source>Advanced</source>
        <translation>Erweitert</translation>
    </message>
    <message>
        <source>Search settings</source>
        <translation>Einstellungen suchen</translation>
    </message>
    <message>
        <source>Pages</source>
        <translation>Seiten</translation>
    </message>
    <message>
        <source>Settings that were found</source>
        <translation>Gefundene Einstellungen</translation>
    </message>
    <message>
        <source>Nothing was found.</source>
        <translation>Nichts gefunden.</translation>
    </message>
    <message>
        <source>What went wrong</source>
        <translation>Was schiefging</translation>
    </message>
    <message>
        <source>Hide</source>
        <translation>Ausblenden</translation>
    </message>
    <message>
        <source>Restore &amp;Defaults</source>
        <translation>Standardwerte &amp;wiederherstellen</translation>
    </message>
    <message>
        <source>Restore the defaults of the page “%1”?</source>
        <translation>Die Standardwerte der Seite „%1“ wiederherstellen?</translation>
    </message>
    <message>
        <source>What you have set on this page is forgotten. Other pages stay as they are.</source>
        <translation>Was auf dieser Seite eingestellt wurde, wird vergessen. Andere Seiten bleiben, wie sie sind.</translation>
    </message>
    <message>
        <source>&amp;Restore Defaults</source>
        <translation>Standardwerte &amp;wiederherstellen</translation>
    </message>
</context>
<context>
    <name>plume::PreviewPane</name>
    <message>
        <source>Included by</source>
        <translation>Enthalten in</translation>
    </message>
    <message>
        <source>Try abbreviations here: they expand.</source>
        <translation>Hier Kürzel ausprobieren: Sie werden ersetzt.</translation>
    </message>
    <message>
        <source>Field to try abbreviations in</source>
        <translation>Feld zum Ausprobieren von Kürzeln</translation>
    </message>
    <message>
        <source>What Comes Out</source>
        <translation>Was herauskommt</translation>
    </message>
    <message numerus="yes">
        <source>%n more</source>
        <translation>
            <numerusform>%n weiterem</numerusform>
            <numerusform>%n weiteren</numerusform>
        </translation>
    </message>
    <message>
        <source>Included by %1</source>
        <translation>Enthalten in %1</translation>
    </message>
</context>
<context>
    <name>plume::ProgramAdder</name>
    <message>
        <source>Add</source>
        <translation>Hinzufügen</translation>
    </message>
    <message>
        <source>Add a program</source>
        <translation>Programm hinzufügen</translation>
    </message>
    <message>
        <source>&amp;Running Program…</source>
        <translation>&amp;Laufendes Programm…</translation>
    </message>
    <message>
        <source>&amp;Installed Program…</source>
        <translation>&amp;Installiertes Programm…</translation>
    </message>
    <message>
        <source>&amp;Point at a Window…</source>
        <translation>Auf ein &amp;Fenster zeigen…</translation>
    </message>
    <message>
        <source>&amp;Type an Identifier…</source>
        <translation>&amp;Kennung eingeben…</translation>
    </message>
    <message>
        <source>Running Programs</source>
        <translation>Laufende Programme</translation>
    </message>
    <message>
        <source>Installed Programs</source>
        <translation>Installierte Programme</translation>
    </message>
    <message>
        <source>Click in a window of the program within 20 seconds.</source>
        <translation>Bitte innerhalb von 20 Sekunden in ein Fenster des Programms klicken.</translation>
    </message>
    <message>
        <source>No window of another program was clicked.</source>
        <translation>Es wurde kein Fenster eines anderen Programms angeklickt.</translation>
    </message>
    <message>
        <source>Add a Program</source>
        <translation>Programm hinzufügen</translation>
    </message>
    <message>
        <source>Identifier of the program: the name of its desktop file without “.desktop”, or its window class</source>
        <translation>Kennung des Programms: der Name seiner Desktop-Datei ohne „.desktop“ oder seine Fensterklasse</translation>
    </message>
    <message>
        <source>&amp;Add Program</source>
        <translation>&amp;Programm hinzufügen</translation>
    </message>
    <message>
        <source>&amp;Cancel</source>
        <translation>&amp;Abbrechen</translation>
    </message>
</context>
<context>
    <name>plume::ProgramChooser</name>
    <message>
        <source>No programs are there to choose from.</source>
        <translation>Es gibt keine Programme zur Auswahl.</translation>
    </message>
    <message>
        <source>Program</source>
        <translation>Programm</translation>
    </message>
    <message>
        <source>Identifier</source>
        <translation>Kennung</translation>
    </message>
    <message>
        <source>Filter</source>
        <translation>Filtern</translation>
    </message>
    <message>
        <source>Programs</source>
        <translation>Programme</translation>
    </message>
    <message>
        <source>&amp;Add Program</source>
        <translation>&amp;Programm hinzufügen</translation>
    </message>
    <message>
        <source>&amp;Cancel</source>
        <translation>&amp;Abbrechen</translation>
    </message>
</context>
<context>
    <name>plume::PromptWindow</name>
    <message>
        <source>Plume</source>
        <translation>Plume</translation>
    </message>
    <message>
        <source>Plume cannot expand abbreviations yet</source>
        <translation>Plume kann noch keine Kürzel ersetzen</translation>
    </message>
    <message>
        <source>Put this right, then choose “Check Again”. You can also continue and do it later: until then Plume runs, but abbreviations may stay as you type them.</source>
        <translation>Bitte beheben und dann „Erneut prüfen“ wählen. Das geht auch später: bis dahin läuft Plume, aber Kürzel bleiben vielleicht so stehen, wie sie getippt wurden.</translation>
    </message>
    <message>
        <source>Check &amp;Again</source>
        <translation>&amp;Erneut prüfen</translation>
    </message>
    <message>
        <source>&amp;Continue Anyway</source>
        <translation>&amp;Trotzdem fortfahren</translation>
    </message>
    <message>
        <source>What is missing</source>
        <translation>Was fehlt</translation>
    </message>
    <message>
        <source>Looked again at %1: it is not right yet. You can also continue and put it right later.</source>
        <translation>Um %1 erneut geprüft: es stimmt noch nicht. Fortfahren geht trotzdem, beheben auch später.</translation>
    </message>
    <message>
        <source>Plume is ready</source>
        <translation>Plume ist bereit</translation>
    </message>
    <message>
        <source>All that was missing is there now.</source>
        <translation>Alles, was fehlte, ist jetzt da.</translation>
    </message>
    <message>
        <source>&amp;Close</source>
        <translation>&amp;Schließen</translation>
    </message>
</context>
<context>
    <name>plume::QuickSearchModel</name>
    <message>
        <source>Similar</source>
        <translation>Ähnlich</translation>
    </message>
</context>
<context>
    <name>plume::QuickSearchWindow</name>
    <message>
        <source>Quick Search</source>
        <translation>Schnellsuche</translation>
    </message>
    <message>
        <source>Return inserts, Ctrl+Return copies, Ctrl+E edits, Esc closes</source>
        <translation>Eingabe setzt ein, Strg+Eingabe kopiert, Strg+E bearbeitet, Esc schließt</translation>
    </message>
    <message>
        <source>Search snippets</source>
        <translation>Snippets suchen</translation>
    </message>
    <message>
        <source>Found snippets</source>
        <translation>Gefundene Snippets</translation>
    </message>
    <message>
        <source>Search in</source>
        <translation>Suchen in</translation>
    </message>
    <message>
        <source>What is searched</source>
        <translation>Was durchsucht wird</translation>
    </message>
    <message>
        <source>&amp;Abbreviations</source>
        <translation>&amp;Kürzel</translation>
    </message>
    <message>
        <source>&amp;Contents</source>
        <translation>&amp;Inhalte</translation>
    </message>
    <message>
        <source>&amp;Labels</source>
        <translation>&amp;Bezeichnungen</translation>
    </message>
    <message>
        <source>&amp;Wildcards</source>
        <translation>&amp;Platzhalter</translation>
    </message>
    <message>
        <source>You have no snippets yet.</source>
        <translation>Noch keine Snippets.</translation>
    </message>
    <message>
        <source>Nothing was found.</source>
        <translation>Nichts gefunden.</translation>
    </message>
</context>
<context>
    <name>plume::ReportsWindow</name>
    <message numerus="yes">
        <source>%1 (%n times)</source>
        <translation>
            <numerusform>%1 (%n-mal)</numerusform>
            <numerusform>%1 (%n-mal)</numerusform>
        </translation>
    </message>
    <message>
        <source>Recent Reports</source>
        <translation>Neueste Meldungen</translation>
    </message>
    <message>
        <source>Plume has had nothing to report.</source>
        <translation>Plume hatte nichts zu melden.</translation>
    </message>
    <message>
        <source>Time</source>
        <translation>Zeit</translation>
    </message>
    <message>
        <source>Report</source>
        <translation>Meldung</translation>
    </message>
    <message>
        <source>What you can do</source>
        <translation>Was zu tun ist</translation>
    </message>
    <message>
        <source>Reports, newest first</source>
        <translation>Meldungen, neueste zuerst</translation>
    </message>
    <message>
        <source>&amp;Copy All</source>
        <translation>Alle &amp;kopieren</translation>
    </message>
    <message>
        <source>C&amp;lear</source>
        <translation>&amp;Leeren</translation>
    </message>
</context>
<context>
    <name>plume::RestoreDataWindowController</name>
    <message>
        <source>%1, %2</source>
        <translation>%1, %2</translation>
    </message>
    <message>
        <source>Restore</source>
        <translation>Wiederherstellen</translation>
    </message>
    <message>
        <source>&amp;Restore Backup</source>
        <translation>Sicherung &amp;wiederherstellen</translation>
    </message>
    <message>
        <source>Backups, newest first</source>
        <translation>Sicherungen, neueste zuerst</translation>
    </message>
    <message>
        <source>&amp;Backups of your snippets:</source>
        <translation>&amp;Sicherungen der Snippets:</translation>
    </message>
    <message>
        <source>Choose &amp;File…</source>
        <translation>&amp;Datei wählen…</translation>
    </message>
    <message>
        <source>Your snippets can be put back to what they were when a backup was made. What you have now is saved first.</source>
        <translation>Die Snippets lassen sich auf den Stand einer Sicherung zurücksetzen. Was jetzt da ist, wird zuvor gesichert.</translation>
    </message>
    <message>
        <source>There is no backup in %1 yet.</source>
        <translation>In %1 ist noch keine Sicherung.</translation>
    </message>
    <message>
        <source>Select a .plume file to restore</source>
        <translation>Eine .plume-Datei zum Wiederherstellen wählen</translation>
    </message>
    <message>
        <source>Plume libraries (*.plume)</source>
        <translation>Plume-Bibliotheken (*.plume)</translation>
    </message>
    <message>
        <source>Your 1 snippet is replaced by what this backup holds:</source>
        <translation>1 Snippet wird durch den Inhalt dieser Sicherung ersetzt:</translation>
    </message>
    <message numerus="yes">
        <source>Your %n snippets are replaced by what this backup holds:</source>
        <translation>
            <numerusform>%n Snippet wird durch den Inhalt dieser Sicherung ersetzt:</numerusform>
            <numerusform>%n Snippets werden durch den Inhalt dieser Sicherung ersetzt:</numerusform>
        </translation>
    </message>
    <message>
        <source>Do you want to restore this backup?</source>
        <translation>Diese Sicherung wiederherstellen?</translation>
    </message>
    <message>
        <source>Plume writes a backup of what you have now first.</source>
        <translation>Plume sichert zuvor, was jetzt da ist.</translation>
    </message>
    <message>
        <source>Replace My Snippets</source>
        <translation>Meine Snippets ersetzen</translation>
    </message>
    <message>
        <source>Error when restoring backup</source>
        <translation>Die Sicherung wurde nicht wiederhergestellt</translation>
    </message>
    <message>
        <source>Your snippets were restored</source>
        <translation>Die Snippets wurden wiederhergestellt</translation>
    </message>
    <message>
        <source>What you had before is in this backup: %1</source>
        <translation>Was vorher da war, ist in dieser Sicherung: %1</translation>
    </message>
    <message>
        <source>The selected backup file does not exist.</source>
        <translation>Die gewählte Sicherung ist nicht vorhanden.</translation>
    </message>
</context>
<context>
    <name>plume::ScriptEdit</name>
    <message>
        <source>Script</source>
        <translation>Skript</translation>
    </message>
    <message>
        <source>Tab writes a tab. To leave the script with the keyboard, press Ctrl+Tab, or Escape and then Tab.</source>
        <translation>Tab schreibt einen Tabulator. Um das Skript mit der Tastatur zu verlassen, Strg+Tab drücken oder Escape und dann Tab.</translation>
    </message>
</context>
<context>
    <name>plume::ScriptMark</name>
    <message>
        <source>Script: %1</source>
        <translation>Skript: %1</translation>
    </message>
    <message>
        <source>What this script prints comes here.</source>
        <translation>Hier steht, was dieses Skript ausgibt.</translation>
    </message>
</context>
<context>
    <name>plume::ScriptRunPanel</name>
    <message>
        <source>Run &amp;Now</source>
        <translation>&amp;Jetzt ausführen</translation>
    </message>
    <message>
        <source>Cance&amp;l</source>
        <translation>Abbre&amp;chen</translation>
    </message>
    <message>
        <source>Output of the script</source>
        <translation>Ausgabe des Skripts</translation>
    </message>
    <message>
        <source>What the script writes is shown here. Nothing is typed anywhere.</source>
        <translation>Was das Skript schreibt, steht hier. Nirgends wird etwas getippt.</translation>
    </message>
    <message>
        <source>Starting…</source>
        <translation>Wird gestartet…</translation>
    </message>
    <message>
        <source>The script&apos;s placeholders cannot be replaced.</source>
        <translation>Die Platzhalter des Skripts lassen sich nicht ersetzen.</translation>
    </message>
    <message>
        <source>Cancelled.</source>
        <translation>Abgebrochen.</translation>
    </message>
    <message>
        <source>Cancelling…</source>
        <translation>Wird abgebrochen…</translation>
    </message>
    <message>
        <source>Running for %1 of at most %2 seconds.</source>
        <translation>Läuft seit %1 von höchstens %2 Sekunden.</translation>
    </message>
    <message>
        <source>AppleScript cannot run on this system.</source>
        <translation>AppleScript kann auf diesem System nicht laufen.</translation>
    </message>
    <message>
        <source>A script is ended after %1 seconds.</source>
        <translation>Ein Skript wird nach %1 Sekunden beendet.</translation>
    </message>
    <message>
        <source>Errors:</source>
        <translation>Fehler:</translation>
    </message>
    <message>
        <source>The script says that it failed, after %1 seconds.</source>
        <translation>Das Skript meldet nach %1 Sekunden, dass es gescheitert ist.</translation>
    </message>
    <message>
        <source>Finished after %1 seconds.</source>
        <translation>Fertig nach %1 Sekunden.</translation>
    </message>
    <message>
        <source>Ended at the time limit of %1 seconds.</source>
        <translation>An der Zeitgrenze von %1 Sekunden beendet.</translation>
    </message>
    <message>
        <source>Ended after %1 seconds, because it wrote too much.</source>
        <translation>Nach %1 Sekunden beendet, weil es zu viel schrieb.</translation>
    </message>
    <message>
        <source>Cancelled after %1 seconds.</source>
        <translation>Nach %1 Sekunden abgebrochen.</translation>
    </message>
    <message>
        <source>The script could not be run: %1.</source>
        <translation>Das Skript konnte nicht laufen: %1.</translation>
    </message>
    <message>
        <source>A script that it includes was ended at the time limit.</source>
        <translation>Ein darin enthaltenes Skript wurde an der Zeitgrenze beendet.</translation>
    </message>
    <message>
        <source>A script that it includes wrote too much.</source>
        <translation>Ein darin enthaltenes Skript schrieb zu viel.</translation>
    </message>
    <message>
        <source>A script that it includes could not be run.</source>
        <translation>Ein darin enthaltenes Skript konnte nicht laufen.</translation>
    </message>
    <message>
        <source>Fields had the values that they begin with.</source>
        <translation>Felder hatten die Werte, mit denen sie beginnen.</translation>
    </message>
    <message>
        <source>The script wrote nothing.</source>
        <translation>Das Skript schrieb nichts.</translation>
    </message>
    <message>
        <source>As there is no other output, the errors are typed when the snippet expands.</source>
        <translation>Da es keine andere Ausgabe gibt, werden die Fehler getippt, wenn das Snippet ersetzt wird.</translation>
    </message>
    <message>
        <source>The output is no UTF-8 text: nothing is typed when the snippet expands.</source>
        <translation>Die Ausgabe ist kein UTF-8-Text: Nichts wird getippt, wenn das Snippet ersetzt wird.</translation>
    </message>
    <message>
        <source>The output is cut here: %1 more characters are not shown.</source>
        <translation>Die Ausgabe ist hier abgeschnitten: %1 weitere Zeichen werden nicht gezeigt.</translation>
    </message>
</context>
<context>
    <name>plume::SettingsModel</name>
    <message>
        <source>Setting</source>
        <translation>Einstellung</translation>
    </message>
    <message>
        <source>Value</source>
        <translation>Wert</translation>
    </message>
    <message>
        <source>Default</source>
        <translation>Standard</translation>
    </message>
</context>
<context>
    <name>plume::SnippetEditor</name>
    <message>
        <source>Plain text</source>
        <translation>Reiner Text</translation>
    </message>
    <message>
        <source>Formatted text</source>
        <translation>Formatierter Text</translation>
    </message>
    <message>
        <source>AppleScript</source>
        <translation>AppleScript</translation>
    </message>
    <message>
        <source>Shell script</source>
        <translation>Shell-Skript</translation>
    </message>
    <message>
        <source>N&amp;ote:</source>
        <translation>&amp;Notiz:</translation>
    </message>
    <message>
        <source>Optional: a name for lists</source>
        <translation>Optional: ein Name für Listen</translation>
    </message>
    <message>
        <source>Optional: for yourself</source>
        <translation>Optional: zur eigenen Information</translation>
    </message>
    <message>
        <source>About the abbreviation</source>
        <translation>Zum Kürzel</translation>
    </message>
    <message>
        <source>&amp;Abbreviation:</source>
        <translation>&amp;Kürzel:</translation>
    </message>
    <message>
        <source>La&amp;bel:</source>
        <translation>Be&amp;zeichnung:</translation>
    </message>
    <message>
        <source>&amp;Kind:</source>
        <translation>A&amp;rt:</translation>
    </message>
    <message>
        <source>&amp;Case:</source>
        <translation>&amp;Schreibweise:</translation>
    </message>
    <message>
        <source>Without an abbreviation it can only be chosen from lists.</source>
        <translation>Ohne Kürzel lässt es sich nur aus Listen wählen.</translation>
    </message>
    <message>
        <source>⚠ “%1” in “%2” has this abbreviation, too.</source>
        <translation>⚠ „%1“ in „%2“ hat dieses Kürzel auch.</translation>
    </message>
    <message>
        <source>⚠ “%1” in “%2” expands before this is typed.</source>
        <translation>⚠ „%1“ in „%2“ wird ersetzt, bevor dieses getippt ist.</translation>
    </message>
    <message>
        <source>Created %1</source>
        <translation>Erstellt %1</translation>
    </message>
    <message>
        <source>Changed %1</source>
        <translation>Geändert %1</translation>
    </message>
    <message>
        <source>Used last %1</source>
        <translation>Zuletzt benutzt %1</translation>
    </message>
    <message>
        <source>Not used yet</source>
        <translation>Noch nicht benutzt</translation>
    </message>
</context>
<context>
    <name>plume::SnippetForm</name>
    <message>
        <source>Snippet</source>
        <translation>Snippet</translation>
    </message>
    <message>
        <source>Abbreviation, label or text</source>
        <translation>Kürzel, Bezeichnung oder Text</translation>
    </message>
    <message>
        <source>&amp;Search:</source>
        <translation>&amp;Suchen:</translation>
    </message>
    <message>
        <source>Snip&amp;pet:</source>
        <translation>Sni&amp;ppet:</translation>
    </message>
    <message>
        <source>Snippets</source>
        <translation>Snippets</translation>
    </message>
    <message>
        <source>Choose a snippet.</source>
        <translation>Ein Snippet wählen.</translation>
    </message>
    <message>
        <source>Gives: nothing</source>
        <translation>Ergibt: nichts</translation>
    </message>
    <message>
        <source>The library has no snippet with this abbreviation.</source>
        <translation>Die Bibliothek hat kein Snippet mit diesem Kürzel.</translation>
    </message>
    <message>
        <source>A snippet cannot stand in itself.</source>
        <translation>Ein Snippet kann nicht in sich selbst stehen.</translation>
    </message>
    <message>
        <source>Runs the script and gives what it prints.</source>
        <translation>Führt das Skript aus und ergibt dessen Ausgabe.</translation>
    </message>
    <message>
        <source>Gives: %1</source>
        <translation>Ergibt: %1</translation>
    </message>
</context>
<context>
    <name>plume::SnippetPreview</name>
    <message>
        <source>Preview of the selected snippet</source>
        <translation>Vorschau des ausgewählten Snippets</translation>
    </message>
    <message>
        <source>A script: what it prints is inserted.</source>
        <translation>Ein Skript: Seine Ausgabe wird eingesetzt.</translation>
    </message>
</context>
<context>
    <name>plume::SnippetRowsMenu</name>
    <message>
        <source>%1 … %2</source>
        <extracomment>The first and the last of a range of snippets.</extracomment>
        <translation>%1 … %2</translation>
    </message>
</context>
<context>
    <name>plume::StatusMenu</name>
    <message>
        <source>Untitled group</source>
        <translation>Unbenannte Gruppe</translation>
    </message>
    <message>
        <source>&amp;Quit Plume</source>
        <translation>&amp;Plume beenden</translation>
    </message>
    <message>
        <source>&amp;Enabled</source>
        <translation>&amp;Eingeschaltet</translation>
    </message>
    <message>
        <source>&amp;Listen to the Keyboard Again</source>
        <translation>&amp;Wieder auf die Tastatur hören</translation>
    </message>
    <message>
        <source>&amp;New Snippet…</source>
        <translation>&amp;Neues Snippet…</translation>
    </message>
    <message>
        <source>New Snippet from &amp;Clipboard…</source>
        <translation>Neues Snippet aus der &amp;Zwischenablage…</translation>
    </message>
    <message>
        <source>New Snippet from &amp;Selection…</source>
        <translation>Neues Snippet aus der &amp;Auswahl…</translation>
    </message>
    <message>
        <source>Searc&amp;h Snippets…</source>
        <translation>Snippets &amp;suchen…</translation>
    </message>
    <message>
        <source>E&amp;dit Snippets…</source>
        <translation>Snippets &amp;bearbeiten…</translation>
    </message>
    <message>
        <source>&amp;Preferences…</source>
        <translation>E&amp;instellungen…</translation>
    </message>
    <message>
        <source>Help and &amp;Tools</source>
        <translation>&amp;Hilfe und Werkzeuge</translation>
    </message>
    <message>
        <source>&amp;Why Didn&apos;t It Expand?</source>
        <translation>&amp;Warum wurde nichts ersetzt?</translation>
    </message>
    <message>
        <source>&amp;Reports</source>
        <translation>&amp;Meldungen</translation>
    </message>
    <message>
        <source>&amp;Diagnostics…</source>
        <translation>&amp;Diagnose…</translation>
    </message>
    <message>
        <source>W&amp;elcome…</source>
        <translation>W&amp;illkommen…</translation>
    </message>
    <message>
        <source>&amp;About Plume</source>
        <translation>Ü&amp;ber Plume</translation>
    </message>
    <message>
        <source>Li&amp;brary</source>
        <translation>Biblio&amp;thek</translation>
    </message>
    <message>
        <source>&amp;Import…</source>
        <translation>&amp;Importieren…</translation>
    </message>
    <message>
        <source>&amp;Export…</source>
        <translation>&amp;Exportieren…</translation>
    </message>
    <message>
        <source>&amp;Restore…</source>
        <translation>&amp;Wiederherstellen…</translation>
    </message>
</context>
<context>
    <name>plume::SuggestionWindow</name>
    <message>
        <source>Suggestions</source>
        <translation>Vorschläge</translation>
    </message>
    <message>
        <source>Suggested snippets</source>
        <translation>Vorgeschlagene Snippets</translation>
    </message>
    <message>
        <source>%1 to %2 of %3</source>
        <translation>%1 bis %2 von %3</translation>
    </message>
</context>
<context>
    <name>plume::TimeForm</name>
    <message>
        <source>Time</source>
        <translation>Uhrzeit</translation>
    </message>
    <message>
        <source>Added:</source>
        <translation>Addiert:</translation>
    </message>
    <message>
        <source>Hours:</source>
        <translation>Stunden:</translation>
    </message>
    <message>
        <source>Hours added</source>
        <translation>Addierte Stunden</translation>
    </message>
    <message>
        <source>Minutes:</source>
        <translation>Minuten:</translation>
    </message>
    <message>
        <source>Minutes added</source>
        <translation>Addierte Minuten</translation>
    </message>
    <message>
        <source>Seconds:</source>
        <translation>Sekunden:</translation>
    </message>
    <message>
        <source>Seconds added</source>
        <translation>Addierte Sekunden</translation>
    </message>
</context>
<context>
    <name>plume::TrayIcon</name>
    <message>
        <source>Plume: off</source>
        <translation>Plume: aus</translation>
    </message>
    <message>
        <source>Plume: does not hear the keyboard</source>
        <translation>Plume: hört die Tastatur nicht</translation>
    </message>
    <message>
        <source>Plume: on</source>
        <translation>Plume: ein</translation>
    </message>
</context>
<context>
    <name>plume::UnsentTextWindow</name>
    <message>
        <source>&amp;Copy</source>
        <translation>&amp;Kopieren</translation>
    </message>
    <message>
        <source>Text Not Inserted</source>
        <translation>Text nicht eingefügt</translation>
    </message>
    <message>
        <source>The text was not inserted</source>
        <translation>Der Text wurde nicht eingefügt</translation>
    </message>
    <message>
        <source>Plume keeps it until you close this window.</source>
        <translation>Plume bewahrt ihn auf, bis Sie dieses Fenster schließen.</translation>
    </message>
    <message>
        <source>The text</source>
        <translation>Der Text</translation>
    </message>
    <message>
        <source>&amp;Try Again</source>
        <translation>&amp;Erneut versuchen</translation>
    </message>
    <message>
        <source>&amp;Discard</source>
        <translation>&amp;Verwerfen</translation>
    </message>
    <message>
        <source>Copied. The text is in the clipboard now.</source>
        <translation>Kopiert. Der Text ist jetzt in der Zwischenablage.</translation>
    </message>
    <message>
        <source>Discard the text? Press Esc or close the window once more to discard it.</source>
        <translation>Den Text verwerfen? Drücken Sie noch einmal Esc oder schließen Sie das Fenster noch einmal, um ihn zu verwerfen.</translation>
    </message>
</context>
<context>
    <name>plume::WelcomeWindow</name>
    <message>
        <source>Welcome to Plume</source>
        <translation>Willkommen bei Plume</translation>
    </message>
    <message>
        <source>&amp;Get Started</source>
        <translation>&amp;Los geht’s</translation>
    </message>
    <message>
        <source>Plume keeps texts that you write often as snippets, each with a short abbreviation. Type the abbreviation in any program, and Plume puts the text in its place. Your snippets stay on this computer.</source>
        <translation>Plume bewahrt oft geschriebene Texte als Snippets auf, jedes mit einem kurzen Kürzel. Wird das Kürzel in einem beliebigen Programm getippt, setzt Plume den Text an seine Stelle. Die Snippets bleiben auf diesem Computer.</translation>
    </message>
    <message>
        <source>Try it</source>
        <translation>Ausprobieren</translation>
    </message>
    <message>
        <source>&amp;Type here:</source>
        <translation>&amp;Hier tippen:</translation>
    </message>
    <message>
        <source>Not tried yet</source>
        <translation>Noch nicht ausprobiert</translation>
    </message>
    <message>
        <source>becomes “%1”</source>
        <translation>wird zu „%1“</translation>
    </message>
    <message>
        <source>Done</source>
        <translation>Geschafft</translation>
    </message>
    <message>
        <source>That is all there is to it.</source>
        <translation>Das ist schon alles.</translation>
    </message>
    <message>
        <source>Bring your snippets along</source>
        <translation>Snippets mitbringen</translation>
    </message>
    <message>
        <source>Snippets of other programs were found. Importing leaves them as they are.</source>
        <translation>Snippets anderer Programme wurden gefunden. Beim Importieren bleiben sie dort, wie sie sind.</translation>
    </message>
    <message>
        <source>Import</source>
        <translation>Importieren</translation>
    </message>
    <message>
        <source>Import %1</source>
        <translation>%1 importieren</translation>
    </message>
    <message>
        <source>Imported</source>
        <translation>Importiert</translation>
    </message>
    <message>
        <source>&amp;Start Plume when I log in</source>
        <translation>Plume beim An&amp;melden starten</translation>
    </message>
    <message>
        <source>Your desktop has no place for Plume’s icon. To reach Plume, run “plume” again, or use its hot keys.</source>
        <translation>Diese Arbeitsumgebung hat keinen Platz für das Symbol von Plume. Zu Plume führen ein erneuter Aufruf von „plume“ und die Tastenkürzel.</translation>
    </message>
    <message>
        <source>This could not be changed</source>
        <translation>Das ließ sich nicht ändern</translation>
    </message>
    <message>
        <source>and a space become “%1”</source>
        <extracomment>What stands before it is an abbreviation; %1 is its text.</extracomment>
        <translation>und ein Leerzeichen werden zu „%1“</translation>
    </message>
</context>
</TS>
