<?xml version="1.0" encoding="utf-8"?>
<!DOCTYPE TS>
<TS version="2.1" language="fr_FR" sourcelanguage="en_US">
<context>
    <name>AdvancedPage</name>
    <message>
        <source>Every setting by its name, as “plume settings” shows it. Values are JSON; those that you have set are bold. Press F2 to change one.</source>
        <translation>Tous les réglages par leur nom, comme les montre «&#x202f;plume settings&#x202f;». Les valeurs sont en JSON&#x202f;; les vôtres sont en gras. F2 modifie une valeur.</translation>
    </message>
    <message>
        <source>All settings</source>
        <translation>Tous les réglages</translation>
    </message>
    <message>
        <source>Filter settings</source>
        <translation>Filtrer les réglages</translation>
    </message>
    <message>
        <source>&amp;Change…</source>
        <translation>&amp;Modifier…</translation>
    </message>
    <message>
        <source>&amp;Use Default</source>
        <translation>Valeur par &amp;défaut</translation>
    </message>
    <message>
        <source>&amp;Show Diagnostics</source>
        <translation>&amp;Afficher le diagnostic</translation>
    </message>
</context>
<context>
    <name>Application</name>
    <message>
        <source>There is already one or more instance(s) of Plume running.</source>
        <translation>Plume est déjà en cours d’exécution.</translation>
    </message>
    <message>
        <source>This instance will exit and bring other instances to front.</source>
        <translation>Ce programme se ferme et celui qui fonctionne déjà passe au premier plan.</translation>
    </message>
</context>
<context>
    <name>ApplicationServices</name>
    <message>
        <source>1 snippet was imported.</source>
        <translation>1 extrait a été importé.</translation>
    </message>
    <message numerus="yes">
        <source>%n snippets were imported.</source>
        <translation>
            <numerusform>%n extrait a été importé.</numerusform>
            <numerusform>%n extraits ont été importés.</numerusform>
        </translation>
    </message>
</context>
<context>
    <name>ApplicationsPage</name>
    <message>
        <source>Plume knows how many programs want to be typed to. Add a program where texts arrive damaged, or not at all.</source>
        <translation>Plume sait comment écrire dans de nombreux programmes. Ajoutez ici un programme où les textes arrivent abîmés, ou n’arrivent pas.</translation>
    </message>
    <message>
        <source>Programs</source>
        <translation>Programmes</translation>
    </message>
    <message>
        <source>How texts are inserted in the chosen program</source>
        <translation>Comment les textes sont insérés dans le programme choisi</translation>
    </message>
    <message>
        <source>Filter programs</source>
        <translation>Filtrer les programmes</translation>
    </message>
    <message>
        <source>Change as &amp;Mine</source>
        <translation>&amp;Personnaliser</translation>
    </message>
    <message>
        <source>Makes a row of your own that begins as this one of Plume’s.</source>
        <translation>Crée votre propre ligne, qui part de celle de Plume.</translation>
    </message>
    <message>
        <source>Remo&amp;ve</source>
        <translation>&amp;Supprimer</translation>
    </message>
    <message>
        <source>Program</source>
        <translation>Programme</translation>
    </message>
    <message>
        <source>Identifier</source>
        <translation>Identifiant</translation>
    </message>
    <message>
        <source>Row of</source>
        <translation>Origine</translation>
    </message>
    <message>
        <source>Kind</source>
        <translation>Type</translation>
    </message>
    <message>
        <source>Yours</source>
        <translation>Personnelle</translation>
    </message>
    <message>
        <source>Plume</source>
        <translation>Plume</translation>
    </message>
    <message>
        <source>Automatic</source>
        <translation>Automatique</translation>
    </message>
    <message>
        <source>Typed</source>
        <translation>Par la frappe</translation>
    </message>
    <message>
        <source>Pasted</source>
        <translation>Par collage</translation>
    </message>
    <message>
        <source>&amp;Insert texts:</source>
        <translation>&amp;Insertion des textes&#x202f;:</translation>
    </message>
    <message>
        <source>As usual</source>
        <translation>Habituelles</translation>
    </message>
    <message>
        <source>&amp;Keys that paste:</source>
        <translation>&amp;Touches pour coller&#x202f;:</translation>
    </message>
    <message>
        <source>Pause &amp;before pasting:</source>
        <translation>Pause a&amp;vant de coller&#x202f;:</translation>
    </message>
    <message>
        <source>Pause &amp;after pasting:</source>
        <translation>Pause &amp;après avoir collé&#x202f;:</translation>
    </message>
    <message>
        <source>Pause after &amp;erasing:</source>
        <translation>Pause après avoir &amp;effacé&#x202f;:</translation>
    </message>
    <message>
        <source>Try it: click in the program and type an abbreviation. Changes hold at once.</source>
        <translation>Pour essayer, cliquez dans le programme et tapez une abréviation. Les changements s’appliquent aussitôt.</translation>
    </message>
    <message>
        <source> seconds</source>
        <translation> s</translation>
    </message>
</context>
<context>
    <name>BackupsPage</name>
    <message>
        <source>Backups</source>
        <translation>Sauvegardes</translation>
    </message>
    <message>
        <source>Folder of backups</source>
        <translation>Dossier des sauvegardes</translation>
    </message>
    <message>
        <source>F&amp;older:</source>
        <translation>&amp;Dossier&#x202f;:</translation>
    </message>
    <message>
        <source> backup</source>
        <translation> sauvegarde</translation>
    </message>
    <message numerus="yes">
        <source> backups</source>
        <translation>
            <numerusform> sauvegarde</numerusform>
            <numerusform> sauvegardes</numerusform>
        </translation>
    </message>
    <message>
        <source>&amp;Keep:</source>
        <translation>&amp;Conserver&#x202f;:</translation>
    </message>
    <message>
        <source>The oldest go when there are more.</source>
        <translation>Au-delà, les plus anciennes sont supprimées.</translation>
    </message>
    <message>
        <source>All backups</source>
        <translation>Toutes les sauvegardes</translation>
    </message>
    <message>
        <source>Never</source>
        <translation>Jamais</translation>
    </message>
    <message>
        <source>Every hour</source>
        <translation>Toutes les heures</translation>
    </message>
    <message>
        <source>Every day</source>
        <translation>Tous les jours</translation>
    </message>
    <message>
        <source>Every week</source>
        <translation>Toutes les semaines</translation>
    </message>
    <message>
        <source>Every 30 days</source>
        <translation>Tous les 30 jours</translation>
    </message>
    <message>
        <source>Back &amp;up:</source>
        <translation>&amp;Sauvegarder&#x202f;:</translation>
    </message>
    <message>
        <source>&amp;Back Up Now</source>
        <translation>Sauvegarder &amp;maintenant</translation>
    </message>
    <message>
        <source>&amp;Restore…</source>
        <translation>Res&amp;taurer…</translation>
    </message>
    <message>
        <source>Back Up Now, Restore</source>
        <translation>Sauvegarder maintenant, restaurer</translation>
    </message>
    <message>
        <source>No backup was made. %1</source>
        <translation>Aucune sauvegarde n’a été faite. %1</translation>
    </message>
    <message>
        <source>Written: %1</source>
        <translation>Sauvegarde écrite&#x202f;: %1</translation>
    </message>
    <message>
        <source>There is no backup in this folder yet.</source>
        <translation>Il n’y a pas encore de sauvegarde dans ce dossier.</translation>
    </message>
    <message>
        <source>There is 1 backup.</source>
        <translation>Il y a 1 sauvegarde.</translation>
    </message>
    <message numerus="yes">
        <source>There are %n backups.</source>
        <translation>
            <numerusform>Il y a %n sauvegarde.</numerusform>
            <numerusform>Il y a %n sauvegardes.</numerusform>
        </translation>
    </message>
    <message>
        <source>The newest was made %1.</source>
        <translation>La plus récente date du %1.</translation>
    </message>
    <message>
        <source>Sync</source>
        <translation>Synchronisation</translation>
    </message>
    <message>
        <source>Keep the library in &amp;step with other computers</source>
        <translation>Synchroniser la &amp;bibliothèque avec d’autres ordinateurs</translation>
    </message>
    <message>
        <source>By a file in a folder that these computers share.</source>
        <translation>Par un fichier dans un dossier que ces ordinateurs partagent.</translation>
    </message>
    <message>
        <source>Shared folder</source>
        <translation>Dossier partagé</translation>
    </message>
    <message>
        <source>Shared &amp;folder:</source>
        <translation>Dossier &amp;partagé&#x202f;:</translation>
    </message>
    <message>
        <source>Some settings &amp;go along</source>
        <translation>&amp;Inclure certains réglages</translation>
    </message>
    <message>
        <source>Those of the pages Typing and clipboard, and Correction.</source>
        <translation>Ceux des pages «&#x202f;Saisie et presse-papiers&#x202f;» et «&#x202f;Correction&#x202f;».</translation>
    </message>
    <message>
        <source>Nothing is kept in step yet: choose a folder that exists.</source>
        <translation>Rien n’est encore synchronisé&#x202f;: choisissez un dossier qui existe.</translation>
    </message>
</context>
<context>
    <name>CaseReset</name>
    <message>
        <source>Typed exactly as it is written</source>
        <translation>Tapée exactement comme elle est écrite</translation>
    </message>
    <message>
        <source>Typed in capitals or not</source>
        <translation>Tapée en majuscules ou non</translation>
    </message>
    <message>
        <source>Typed in capitals or not, and the text adapts</source>
        <translation>Tapée en majuscules ou non, et le texte s’adapte</translation>
    </message>
    <message>
        <source>Reset Case Sensitivity</source>
        <translation>Réinitialiser la casse</translation>
    </message>
    <message>
        <source>Case sensitivity of all snippets</source>
        <translation>Casse de tous les extraits</translation>
    </message>
    <message>
        <source>Reset</source>
        <translation>Réinitialiser</translation>
    </message>
    <message>
        <source>Cancel</source>
        <translation>Annuler</translation>
    </message>
    <message>
        <source>This will reset case sensitivity of all snippets in group to default setting.</source>
        <translation>La casse de tous les extraits du groupe reprendra sa valeur par défaut.</translation>
    </message>
    <message>
        <source>You can undo this action.</source>
        <translation>Vous pouvez annuler cette action.</translation>
    </message>
</context>
<context>
    <name>ChipWords</name>
    <message>
        <source>today</source>
        <translation>aujourd’hui</translation>
    </message>
    <message>
        <source>1 year</source>
        <translation>1 an</translation>
    </message>
    <message>
        <source>%1 years</source>
        <translation>%1 ans</translation>
    </message>
    <message>
        <source>1 month</source>
        <translation>1 mois</translation>
    </message>
    <message>
        <source>%1 months</source>
        <translation>%1 mois</translation>
    </message>
    <message>
        <source>1 week</source>
        <translation>1 semaine</translation>
    </message>
    <message>
        <source>%1 weeks</source>
        <translation>%1 semaines</translation>
    </message>
    <message>
        <source>1 day</source>
        <translation>1 jour</translation>
    </message>
    <message>
        <source>%1 days</source>
        <translation>%1 jours</translation>
    </message>
    <message>
        <source>now</source>
        <translation>maintenant</translation>
    </message>
    <message>
        <source>1 hour</source>
        <translation>1 heure</translation>
    </message>
    <message>
        <source>%1 hours</source>
        <translation>%1 heures</translation>
    </message>
    <message>
        <source>1 minute</source>
        <translation>1 minute</translation>
    </message>
    <message>
        <source>%1 minutes</source>
        <translation>%1 minutes</translation>
    </message>
    <message>
        <source>1 second</source>
        <translation>1 seconde</translation>
    </message>
    <message>
        <source>%1 seconds</source>
        <translation>%1 secondes</translation>
    </message>
    <message>
        <source>%1 (optional, ticked)</source>
        <translation>%1 (facultatif, coché)</translation>
    </message>
    <message>
        <source>%1 (optional)</source>
        <translation>%1 (facultatif)</translation>
    </message>
    <message>
        <source>Snippet</source>
        <translation>Extrait</translation>
    </message>
    <message>
        <source>Caret</source>
        <translation>Point d’insertion</translation>
    </message>
    <message>
        <source>next %1</source>
        <translation>%1 prochain</translation>
    </message>
    <message>
        <source>previous %1</source>
        <translation>%1 dernier</translation>
    </message>
    <message>
        <source>Date</source>
        <translation>Date</translation>
    </message>
    <message>
        <source>Time</source>
        <translation>Heure</translation>
    </message>
    <message>
        <source>Clipboard</source>
        <translation>Presse-papiers</translation>
    </message>
    <message>
        <source>without %1</source>
        <translation>sans %1</translation>
    </message>
    <message>
        <source>Text area</source>
        <translation>Zone de texte</translation>
    </message>
    <message>
        <source>Menu</source>
        <translation>Menu</translation>
    </message>
    <message>
        <source>Number</source>
        <translation>Nombre</translation>
    </message>
    <message>
        <source>Field</source>
        <translation>Champ</translation>
    </message>
    <message>
        <source>Ctrl</source>
        <translation>Ctrl</translation>
    </message>
    <message>
        <source>Alt</source>
        <translation>Alt</translation>
    </message>
    <message>
        <source>Shift</source>
        <translation>Maj</translation>
    </message>
    <message>
        <source>Super</source>
        <translation>Super</translation>
    </message>
    <message>
        <source>Key</source>
        <translation>Touche</translation>
    </message>
    <message>
        <source>, after %1 s</source>
        <translation>, après %1 s</translation>
    </message>
</context>
<context>
    <name>CorrectionPage</name>
    <message>
        <source>Sentences</source>
        <translation>Phrases</translation>
    </message>
    <message>
        <source>Begin every &amp;sentence with a capital</source>
        <translation>Commencer chaque phrase par une &amp;majuscule</translation>
    </message>
    <message>
        <source>&amp;No sentence ends with:</source>
        <translation>Pas de &amp;fin de phrase après&#x202f;:</translation>
    </message>
    <message>
        <source>One in each line.</source>
        <translation>Une entrée par ligne.</translation>
    </message>
    <message>
        <source>Words</source>
        <translation>Mots</translation>
    </message>
    <message>
        <source>Correct &amp;two capitals at the start of a word</source>
        <translation>Corriger &amp;deux majuscules en début de mot</translation>
    </message>
    <message>
        <source>&amp;Leave these words:</source>
        <translation>&amp;Laisser ces mots&#x202f;:</translation>
    </message>
    <message>
        <source>Where</source>
        <translation>Où</translation>
    </message>
    <message>
        <source>&amp;Correct:</source>
        <translation>&amp;Corriger&#x202f;:</translation>
    </message>
    <message>
        <source>&amp;Keyboard layouts:</source>
        <translation>Di&amp;spositions de clavier&#x202f;:</translation>
    </message>
    <message>
        <source>With all layouts</source>
        <translation>Avec toutes les dispositions</translation>
    </message>
    <message>
        <source>With all layouts except those below</source>
        <translation>Avec toutes les dispositions sauf celles-ci</translation>
    </message>
    <message>
        <source>Only with the layouts below</source>
        <translation>Seulement avec les dispositions ci-dessous</translation>
    </message>
    <message>
        <source>Layo&amp;uts:</source>
        <translation>Disposi&amp;tions&#x202f;:</translation>
    </message>
    <message>
        <source>One in each line, like “us”, “de(nodeadkeys)” or “ibus:libpinyin”.</source>
        <translation>Une entrée par ligne, comme «&#x202f;us&#x202f;», «&#x202f;de(nodeadkeys)&#x202f;» ou «&#x202f;ibus:libpinyin&#x202f;».</translation>
    </message>
</context>
<context>
    <name>DecisionWords</name>
    <message>
        <source>expanded</source>
        <translation>développée</translation>
    </message>
    <message>
        <source>expanded in %1</source>
        <translation>développée dans %1</translation>
    </message>
    <message>
        <source>offered in a list, as one of several that match</source>
        <translation>proposée dans une liste, parmi plusieurs qui conviennent</translation>
    </message>
    <message>
        <source>its content could not be expanded</source>
        <translation>son contenu n’a pas pu être développé</translation>
    </message>
    <message>
        <source>the group is not meant for a program that Plume cannot name</source>
        <translation>le groupe n’est pas prévu pour un programme que Plume ne reconnaît pas</translation>
    </message>
    <message>
        <source>the group is not meant for %1</source>
        <translation>le groupe n’est pas prévu pour %1</translation>
    </message>
    <message>
        <source>the group is not meant for this keyboard layout or input method</source>
        <translation>le groupe n’est pas prévu pour cette disposition de clavier ou cette méthode de saisie</translation>
    </message>
    <message>
        <source>its capital and small letters were typed differently</source>
        <translation>ses majuscules et minuscules ont été tapées autrement</translation>
    </message>
    <message>
        <source>the group does not expand after the key that followed</source>
        <translation>le groupe ne développe pas après la touche qui a suivi</translation>
    </message>
    <message>
        <source>Plume was switched off</source>
        <translation>Plume a été désactivé</translation>
    </message>
    <message>
        <source>Plume was switched on</source>
        <translation>Plume a été activé</translation>
    </message>
    <message>
        <source>a password field or another program kept the keyboard to itself</source>
        <translation>un champ de mot de passe ou un autre programme a gardé le clavier pour lui</translation>
    </message>
    <message>
        <source>Plume could hear the keyboard again</source>
        <translation>Plume a pu entendre de nouveau le clavier</translation>
    </message>
    <message>
        <source>no space or other delimiter stood before it</source>
        <translation>aucune espace ni autre séparateur ne la précédait</translation>
    </message>
    <message>
        <source>no space or new line stood before it</source>
        <translation>aucune espace ni nouvelle ligne ne la précédait</translation>
    </message>
    <message>
        <source>no number stood before it</source>
        <translation>aucun nombre ne la précédait</translation>
    </message>
    <message>
        <source>part of its prefix stood before it once more</source>
        <translation>une partie de son préfixe la précédait une fois de plus</translation>
    </message>
    <message>
        <source>the group wants something else before it</source>
        <translation>le groupe demande autre chose devant elle</translation>
    </message>
    <message>
        <source>“%1”</source>
        <translation>«&#x202f;%1&#x202f;»</translation>
    </message>
    <message>
        <source>“%1” (group %2)</source>
        <translation>«&#x202f;%1&#x202f;» (groupe %2)</translation>
    </message>
    <message>
        <source>%1 was %2.</source>
        <extracomment>%1 is an abbreviation, %2 for example &quot;expanded in xterm&quot;</extracomment>
        <translation>L’abréviation %1 a été %2.</translation>
    </message>
    <message>
        <source>%1.</source>
        <translation>%1.</translation>
    </message>
    <message>
        <source>%1 did not expand: %2.</source>
        <extracomment>%1 is an abbreviation, %2 for example &quot;the group is not meant for xterm&quot;</extracomment>
        <translation>L’abréviation %1 n’a pas été développée&#x202f;: %2.</translation>
    </message>
    <message>
        <source>Choose from the list, or give each snippet an abbreviation of its own.</source>
        <translation>Choisissez dans la liste, ou donnez à chaque extrait sa propre abréviation.</translation>
    </message>
    <message>
        <source>Have a look at the snippet’s content. What was wrong with it may have been reported.</source>
        <translation>Regardez le contenu de l’extrait. Les rapports disent peut-être ce qui ne va pas.</translation>
    </message>
    <message>
        <source>Change the list of programs in the group’s settings.</source>
        <translation>Modifiez la liste des programmes dans les réglages du groupe.</translation>
    </message>
    <message>
        <source>Change to another keyboard layout, or change the list of them in the group’s settings.</source>
        <translation>Passez à une autre disposition de clavier, ou modifiez leur liste dans les réglages du groupe.</translation>
    </message>
    <message>
        <source>Type it where that fits, or change in the group’s settings what must stand before an abbreviation.</source>
        <translation>Tapez-la là où cela convient, ou modifiez dans les réglages du groupe ce qui doit précéder une abréviation.</translation>
    </message>
    <message>
        <source>Type it as it is written here, or let the snippet ignore case.</source>
        <translation>Tapez-la comme elle est écrite ici, ou laissez l’extrait ignorer la casse.</translation>
    </message>
    <message>
        <source>Type one of the group’s own delimiters, or add this one to them in the group’s settings.</source>
        <translation>Tapez un des séparateurs du groupe, ou ajoutez celui-ci dans les réglages du groupe.</translation>
    </message>
    <message>
        <source>Nothing expands until you switch Plume on in the menu of its icon.</source>
        <translation>Rien n’est développé tant que Plume n’est pas réactivé dans le menu de son icône.</translation>
    </message>
    <message>
        <source>Nothing expands until you leave the field, or the other program lets the keyboard go.</source>
        <translation>Rien n’est développé tant que vous n’avez pas quitté le champ, ou que l’autre programme n’a pas libéré le clavier.</translation>
    </message>
</context>
<context>
    <name>ExpansionPage</name>
    <message>
        <source>Capitals</source>
        <translation>Majuscules</translation>
    </message>
    <message>
        <source>Mixed &amp;case gives every word a capital</source>
        <translation>La &amp;casse mixte met une majuscule à chaque mot</translation>
    </message>
    <message>
        <source>Where a text adapts to how its abbreviation is typed: “bRb” gives every word a capital. Without this only one that ends with a capital does, like “bRB”.</source>
        <translation>Là où un texte s’adapte à la frappe de son abréviation, «&#x202f;bRb&#x202f;» met une majuscule à chaque mot. Sinon, seule une abréviation qui finit par une majuscule le fait, comme «&#x202f;bRB&#x202f;».</translation>
    </message>
    <message>
        <source>Typing</source>
        <translation>Saisie</translation>
    </message>
    <message>
        <source>A mouse click &amp;ends the abbreviation</source>
        <translation>Un clic de souris &amp;termine l’abréviation</translation>
    </message>
    <message>
        <source>What was typed before a click and what is typed after it are then never one abbreviation.</source>
        <translation>Ce qui est tapé avant un clic et ce qui est tapé après ne forment alors jamais une même abréviation.</translation>
    </message>
    <message>
        <source>Passwords</source>
        <translation>Mots de passe</translation>
    </message>
    <message>
        <source>Let programs tell which fields are for &amp;passwords</source>
        <translation>Laisser les programmes signaler les champs de &amp;mot de passe</translation>
    </message>
    <message>
        <source>Plume is deaf in these fields. Browsers and some other programs tell it only while the desktop’s accessibility is on, which this switches on when Plume starts. It costs these programs some time and memory.</source>
        <translation>Plume n’écoute pas dans ces champs. Les navigateurs et quelques autres programmes ne les signalent que si l’accessibilité du bureau est activée, ce que Plume fait alors à son lancement. Cela coûte à ces programmes un peu de temps et de mémoire.</translation>
    </message>
    <message>
        <source>Forms</source>
        <translation>Formulaires</translation>
    </message>
    <message>
        <source>&amp;Fill in fields in a plain window</source>
        <translation>Remplir les champs dans une &amp;fenêtre simple</translation>
    </message>
    <message>
        <source>Instead of a page that looks like the text. The program that draws pages needs some 200 MB while forms are in use, and goes ten minutes after the last one.</source>
        <translation>Au lieu d’une page qui ressemble au texte. Le programme qui dessine les pages prend quelque 200 Mo tant que des formulaires sont utilisés, et se termine dix minutes après le dernier.</translation>
    </message>
</context>
<context>
    <name>FormWords</name>
    <message>
        <source>This is not a number.</source>
        <translation>Ce n’est pas un nombre.</translation>
    </message>
    <message>
        <source>This formula cannot be computed.</source>
        <translation>Cette formule ne peut pas être calculée.</translation>
    </message>
    <message>
        <source>This formula depends on itself.</source>
        <translation>Cette formule dépend d’elle-même.</translation>
    </message>
    <message>
        <source>A number is missing that this is computed from.</source>
        <translation>Il manque un nombre nécessaire à ce calcul.</translation>
    </message>
    <message>
        <source>%1 character, and what the script adds</source>
        <translation>%1 caractère, plus ce qu’ajoute le script</translation>
    </message>
    <message numerus="yes">
        <source>%1 characters, and what the script adds</source>
        <translation>
            <numerusform>%1 caractère, plus ce qu’ajoute le script</numerusform>
            <numerusform>%1 caractères, plus ce qu’ajoute le script</numerusform>
        </translation>
    </message>
    <message>
        <source>%1 character</source>
        <translation>%1 caractère</translation>
    </message>
    <message numerus="yes">
        <source>%1 characters</source>
        <translation>
            <numerusform>%1 caractère</numerusform>
            <numerusform>%1 caractères</numerusform>
        </translation>
    </message>
    <message>
        <source>Return inserts</source>
        <translation>Entrée insère</translation>
    </message>
    <message>
        <source>Ctrl+Return inserts from anywhere</source>
        <translation>Ctrl+Entrée insère de partout</translation>
    </message>
    <message>
        <source>Alt+letter takes a part or leaves it out</source>
        <translation>Alt+lettre prend une partie ou l’omet</translation>
    </message>
    <message>
        <source>Esc cancels</source>
        <translation>Échap annule</translation>
    </message>
    <message>
        <source>Insert</source>
        <translation>Insérer</translation>
    </message>
    <message>
        <source>Cancel</source>
        <translation>Annuler</translation>
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
        <translation>&amp;Développer les abréviations</translation>
    </message>
    <message>
        <source>Show the &amp;icon in the panel</source>
        <translation>Afficher l’&amp;icône dans le tableau de bord</translation>
    </message>
    <message>
        <source>Its menu leads to everything that Plume can do.</source>
        <translation>Son menu mène à tout ce que Plume sait faire.</translation>
    </message>
    <message>
        <source>Sound</source>
        <translation>Son</translation>
    </message>
    <message>
        <source>&amp;Play a sound with every expansion</source>
        <translation>&amp;Jouer un son à chaque développement</translation>
    </message>
    <message>
        <source>Text</source>
        <translation>Texte</translation>
    </message>
    <message>
        <source> point</source>
        <translation> point</translation>
    </message>
    <message numerus="yes">
        <source> points</source>
        <translation>
            <numerusform> point</numerusform>
            <numerusform> points</numerusform>
        </translation>
    </message>
    <message>
        <source>&amp;Larger text in lists:</source>
        <translation>&amp;Texte plus grand dans les listes&#x202f;:</translation>
    </message>
    <message>
        <source>How much larger than usual lists and menus are written.</source>
        <translation>De combien agrandir le texte des listes et des menus.</translation>
    </message>
    <message>
        <source>&amp;Start Plume when I log in</source>
        <translation>Lancer Plume à l’&amp;ouverture de session</translation>
    </message>
    <message>
        <source>This could not be kept. %1</source>
        <translation>Cela n’a pas pu être enregistré. %1</translation>
    </message>
    <message>
        <source>&amp;Test</source>
        <translation>É&amp;couter</translation>
    </message>
    <message>
        <source>Test the sound</source>
        <translation>Écouter le son</translation>
    </message>
    <message>
        <source>So&amp;und:</source>
        <translation>&amp;Son&#x202f;:</translation>
    </message>
    <message>
        <source>&amp;Font of new snippets:</source>
        <translation>&amp;Police des nouveaux extraits&#x202f;:</translation>
    </message>
    <message>
        <source>%1, %2 points…</source>
        <translation>%1, %2 points…</translation>
    </message>
    <message>
        <source>Font of new snippets: %1</source>
        <translation>Police des nouveaux extraits&#x202f;: %1</translation>
    </message>
    <message>
        <source>Font of New Snippets</source>
        <translation>Police des nouveaux extraits</translation>
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
        <translation>Taper %1 ne fait rien&#x202f;: ces extraits ne se choisissent que dans des listes.</translation>
    </message>
    <message>
        <source>Typing %1 does nothing: the group is switched off in all programs.</source>
        <translation>Taper %1 ne fait rien&#x202f;: le groupe est désactivé dans tous les programmes.</translation>
    </message>
    <message>
        <source>Typing %1 does nothing: no program is chosen yet.</source>
        <translation>Taper %1 ne fait rien&#x202f;: aucun programme n’est encore choisi.</translation>
    </message>
    <message>
        <source>Typing %1 does nothing: no keyboard layout is chosen yet.</source>
        <translation>Taper %1 ne fait rien&#x202f;: aucune disposition de clavier n’est encore choisie.</translation>
    </message>
    <message>
        <source>Typing %1 does nothing: no character is chosen to expand it.</source>
        <translation>Taper %1 ne fait rien&#x202f;: aucun caractère n’est choisi pour le développement.</translation>
    </message>
    <message>
        <source>in %1 only: %2</source>
        <translation>dans %1 seulement&#x202f;: %2</translation>
    </message>
    <message>
        <source>everywhere but in %1: %2</source>
        <translation>partout sauf dans %1&#x202f;: %2</translation>
    </message>
    <message>
        <source>Not with the keyboard layout %1.</source>
        <translation>Pas avec la disposition de clavier %1.</translation>
    </message>
    <message>
        <source>Not with the keyboard layouts %1.</source>
        <translation>Pas avec les dispositions de clavier %1.</translation>
    </message>
    <message>
        <source>Only with the keyboard layout %1.</source>
        <translation>Seulement avec la disposition de clavier %1.</translation>
    </message>
    <message>
        <source>Only with the keyboard layouts %1.</source>
        <translation>Seulement avec les dispositions de clavier %1.</translation>
    </message>
    <message>
        <source>%1, then %2.</source>
        <translation>%1, puis %2.</translation>
    </message>
    <message>
        <source>%1, then %2, which is left out.</source>
        <translation>%1, puis %2, qui ne reste pas.</translation>
    </message>
    <message>
        <source>%1, then press the hot key that expands.</source>
        <translation>%1, puis le raccourci clavier qui développe.</translation>
    </message>
    <message>
        <source>%1, and it expands at once.</source>
        <translation>%1, et le développement est immédiat.</translation>
    </message>
    <message>
        <source>type %1</source>
        <translation>tapez %1</translation>
    </message>
    <message>
        <source>type %1 behind a space or in a new line</source>
        <translation>tapez %1 après une espace ou sur une nouvelle ligne</translation>
    </message>
    <message>
        <source>type %1, even inside a word</source>
        <translation>tapez %1, même à l’intérieur d’un mot</translation>
    </message>
    <message>
        <source>type %1 right behind a number</source>
        <translation>tapez %1 juste après un nombre</translation>
    </message>
    <message>
        <source>type %1 before anything else</source>
        <translation>tapez %1 avant toute autre chose</translation>
    </message>
    <message>
        <source>type %1 behind %2</source>
        <translation>tapez %1 après %2</translation>
    </message>
    <message>
        <source>“%1”</source>
        <translation>«&#x202f;%1&#x202f;»</translation>
    </message>
    <message>
        <source>a space, Return or a punctuation mark</source>
        <translation>une espace, Entrée ou un signe de ponctuation</translation>
    </message>
    <message>
        <source>a space</source>
        <translation>une espace</translation>
    </message>
    <message>
        <source>Tab</source>
        <translation>Tab</translation>
    </message>
    <message>
        <source>Return</source>
        <translation>Entrée</translation>
    </message>
    <message>
        <source>Enter</source>
        <translation>Entrée du pavé numérique</translation>
    </message>
    <message numerus="yes">
        <source>%n others</source>
        <translation>
            <numerusform>%n autre</numerusform>
            <numerusform>%n autres</numerusform>
        </translation>
    </message>
    <message>
        <source>%1 and %2</source>
        <translation>%1 et %2</translation>
    </message>
    <message>
        <source>, </source>
        <translation>, </translation>
    </message>
    <message numerus="yes">
        <source>one of %n others</source>
        <translation>
            <numerusform>%n autre</numerusform>
            <numerusform>l’un de %n autres</numerusform>
        </translation>
    </message>
    <message>
        <source>%1 or %2</source>
        <translation>%1 ou %2</translation>
    </message>
</context>
<context>
    <name>HotKeysPage</name>
    <message>
        <source>Switch expansion on and off</source>
        <translation>Activer ou non le développement</translation>
    </message>
    <message>
        <source>Expand the abbreviation just typed</source>
        <translation>Développer l’abréviation tapée</translation>
    </message>
    <message>
        <source>Undo the last expansion</source>
        <translation>Annuler le dernier développement</translation>
    </message>
    <message>
        <source>The key that caused it comes back too.</source>
        <translation>La touche qui l’a déclenché revient aussi.</translation>
    </message>
    <message>
        <source>Undo without that key</source>
        <translation>Annuler sans cette touche</translation>
    </message>
    <message>
        <source>Only the abbreviation comes back.</source>
        <translation>Seule l’abréviation revient.</translation>
    </message>
    <message>
        <source>Suggest abbreviations</source>
        <translation>Suggérer des abréviations</translation>
    </message>
    <message>
        <source>Quick search</source>
        <translation>Recherche rapide</translation>
    </message>
    <message>
        <source>Quick search, asked of the desktop</source>
        <translation>Recherche rapide, par le bureau</translation>
    </message>
    <message>
        <source>Works also where Plume does not hear the keys.</source>
        <translation>Marche aussi là où Plume n’entend pas les touches.</translation>
    </message>
    <message>
        <source>Open the snippets window</source>
        <translation>Ouvrir la fenêtre des extraits</translation>
    </message>
    <message>
        <source>Open the snippet used last</source>
        <translation>Ouvrir le dernier extrait utilisé</translation>
    </message>
    <message>
        <source>New snippet from the selection</source>
        <translation>Nouvel extrait de la sélection</translation>
    </message>
    <message>
        <source>New snippet from the clipboard</source>
        <translation>Nouvel extrait du presse-papiers</translation>
    </message>
    <message>
        <source>Click a field, or press Space in it, and then the keys that you want.</source>
        <translation>Cliquez dans un champ, ou appuyez-y sur Espace, puis tapez les touches voulues.</translation>
    </message>
    <message>
        <source>Expanding</source>
        <translation>Développement</translation>
    </message>
    <message>
        <source>Finding snippets</source>
        <translation>Trouver des extraits</translation>
    </message>
    <message>
        <source>Making and changing snippets</source>
        <translation>Créer et modifier des extraits</translation>
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
        <translation>&amp;Importer un fichier…</translation>
    </message>
    <message>
        <source>Snippets of Plume or of another program are added to yours.</source>
        <translation>Des extraits de Plume ou d’un autre programme s’ajoutent aux vôtres.</translation>
    </message>
    <message>
        <source>Export</source>
        <translation>Export</translation>
    </message>
    <message>
        <source>&amp;Export the Library…</source>
        <translation>&amp;Exporter la bibliothèque…</translation>
    </message>
    <message>
        <source>All snippets go into one file, for another computer or another program.</source>
        <translation>Tous les extraits vont dans un fichier, pour un autre ordinateur ou un autre programme.</translation>
    </message>
</context>
<context>
    <name>LibraryUndo</name>
    <message>
        <source>Change of Abbreviation</source>
        <translation>Changement d’abréviation</translation>
    </message>
    <message>
        <source>Change of Label</source>
        <translation>Changement de libellé</translation>
    </message>
    <message>
        <source>Change of Note</source>
        <translation>Changement de note</translation>
    </message>
    <message>
        <source>Change of Case</source>
        <translation>Changement de casse</translation>
    </message>
    <message>
        <source>Change of Kind</source>
        <translation>Changement de type</translation>
    </message>
    <message>
        <source>Change of Content</source>
        <translation>Changement de contenu</translation>
    </message>
    <message>
        <source>Change of Group Name</source>
        <translation>Changement du nom de groupe</translation>
    </message>
    <message>
        <source>Change of Group Settings</source>
        <translation>Changement des réglages du groupe</translation>
    </message>
    <message>
        <source>New Snippets (%n)</source>
        <translation>Nouveaux extraits (%n)</translation>
    </message>
    <message>
        <source>New Groups (%n)</source>
        <translation>Nouveaux groupes (%n)</translation>
    </message>
    <message>
        <source>Deletion (%n)</source>
        <translation>Suppression (%n)</translation>
    </message>
    <message>
        <source>Move (%n)</source>
        <translation>Déplacement (%n)</translation>
    </message>
    <message>
        <source>Copy (%n)</source>
        <translation>Copie (%n)</translation>
    </message>
    <message>
        <source>Duplication (%n)</source>
        <translation>Duplication (%n)</translation>
    </message>
    <message>
        <source>Deletion of Duplicates (%n)</source>
        <translation>Suppression de doublons (%n)</translation>
    </message>
    <message>
        <source>Sorting</source>
        <translation>Tri</translation>
    </message>
    <message>
        <source>Sorting of Groups</source>
        <translation>Tri des groupes</translation>
    </message>
    <message>
        <source>Reset of Case (%n)</source>
        <translation>Réinitialisation de la casse (%n)</translation>
    </message>
    <message>
        <source>New Group</source>
        <translation>Nouveau groupe</translation>
    </message>
    <message>
        <source>Import</source>
        <translation>Import</translation>
    </message>
    <message>
        <source>Kept Edit</source>
        <translation>Modification conservée</translation>
    </message>
</context>
<context>
    <name>MenuTexts</name>
    <message>
        <source>Empty snippet</source>
        <translation>Extrait vide</translation>
    </message>
    <message>
        <source>%1 — %2</source>
        <extracomment>%1 is an abbreviation, %2 what it stands for.</extracomment>
        <translation>%1 — %2</translation>
    </message>
</context>
<context>
    <name>SearchPage</name>
    <message>
        <source>Lists at the caret</source>
        <translation>Listes au point d’insertion</translation>
    </message>
    <message>
        <source>&amp;Key held to pick with a digit:</source>
        <translation>&amp;Touche pour choisir par chiffre&#x202f;:</translation>
    </message>
    <message>
        <source>None</source>
        <translation>Aucune</translation>
    </message>
    <message>
        <source>Shift</source>
        <translation>Maj</translation>
    </message>
    <message>
        <source>Control</source>
        <translation>Ctrl</translation>
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
        <translation>La recherche rapide porte sur</translation>
    </message>
    <message>
        <source>&amp;Abbreviations</source>
        <translation>Les &amp;abréviations</translation>
    </message>
    <message>
        <source>&amp;Contents</source>
        <translation>Les &amp;contenus</translation>
    </message>
    <message>
        <source>&amp;Labels</source>
        <translation>Les &amp;libellés</translation>
    </message>
    <message>
        <source>&amp;Wildcards in quick search</source>
        <translation>&amp;Jokers dans la recherche rapide</translation>
    </message>
    <message>
        <source>* stands for any text, and ? for any character.</source>
        <translation>* remplace tout texte et&#x202f;? tout caractère.</translation>
    </message>
    <message>
        <source>The snippets window looks in</source>
        <translation>Dans la fenêtre des extraits, la recherche porte sur</translation>
    </message>
    <message>
        <source>A&amp;bbreviations</source>
        <translation>Les a&amp;bréviations</translation>
    </message>
    <message>
        <source>C&amp;ontents</source>
        <translation>Les c&amp;ontenus</translation>
    </message>
    <message>
        <source>Lab&amp;els</source>
        <translation>Les l&amp;ibellés</translation>
    </message>
    <message>
        <source>At least one is needed.</source>
        <translation>Il en faut au moins un.</translation>
    </message>
    <message>
        <source>&amp;Suggest snippets while I type</source>
        <translation>&amp;Suggérer des extraits pendant la frappe</translation>
    </message>
    <message>
        <source>A list comes up by itself after a pause in an abbreviation of which two letters are typed. Return takes its selected snippet, Esc closes it.</source>
        <translation>Une liste apparaît d’elle-même après une pause dans une abréviation dont deux lettres sont tapées. Entrée prend l’extrait sélectionné, Échap la ferme.</translation>
    </message>
    <message>
        <source>Quick search</source>
        <translation>Recherche rapide</translation>
    </message>
    <message>
        <source>Be&amp;gin with the word before the caret</source>
        <translation>Commencer par le &amp;mot avant le point d’insertion</translation>
    </message>
    <message>
        <source>The snippet that is chosen takes its place then.</source>
        <translation>L’extrait choisi prend alors sa place.</translation>
    </message>
    <message>
        <source>Show often &amp;used snippets first</source>
        <translation>Afficher d’abord les &amp;extraits souvent utilisés</translation>
    </message>
    <message>
        <source>How often each snippet is used is kept on this computer, never what was searched for.</source>
        <translation>Le nombre d’utilisations de chaque extrait est gardé sur cet ordinateur, jamais ce qui a été cherché.</translation>
    </message>
    <message>
        <source>&amp;Forget How Often Snippets Were Used</source>
        <translation>O&amp;ublier combien de fois les extraits ont servi</translation>
    </message>
    <message>
        <source>Forget How Often Snippets Were Used</source>
        <translation>Oublier combien de fois les extraits ont servi</translation>
    </message>
    <message>
        <source>In suggestions and in quick search, the digits 1 to 9 pick a snippet while this key is held, and 0 picks the tenth.</source>
        <translation>Dans les suggestions et la recherche rapide, les chiffres de 1 à 9 choisissent un extrait tant que cette touche est enfoncée, et 0 le dixième.</translation>
    </message>
    <message>
        <source>Wildcards in the snippets w&amp;indow</source>
        <translation>Jokers dans la &amp;fenêtre des extraits</translation>
    </message>
</context>
<context>
    <name>Sentences</name>
    <message>
        <source>Plume is not working: it cannot hear the keyboard.</source>
        <translation>Plume ne fonctionne pas&#x202f;: il n’entend pas le clavier.</translation>
    </message>
    <message>
        <source>%1 takes keys, too. When letters get lost or come twice, end one of the two.</source>
        <translation>%1 prend aussi des touches. Si des lettres se perdent ou viennent deux fois, quittez l’un des deux.</translation>
    </message>
    <message>
        <source>Listening to the keyboard was ended three times within a minute, because Plume did not answer in time. It is tried again in a minute.</source>
        <translation>L’écoute du clavier a été interrompue trois fois en une minute, parce que Plume n’a pas répondu à temps. Elle reprendra dans une minute.</translation>
    </message>
    <message>
        <source>Plume does not listen</source>
        <translation>Plume n’écoute pas</translation>
    </message>
    <message>
        <source>Listen now</source>
        <translation>Écouter maintenant</translation>
    </message>
    <message>
        <source>Show Reports</source>
        <translation>Montrer les rapports</translation>
    </message>
    <message>
        <source>The snippet was not sent: another program holds the keyboard, or a password is asked for.</source>
        <translation>L’extrait n’a pas été envoyé&#x202f;: un autre programme tient le clavier, ou un mot de passe est demandé.</translation>
    </message>
    <message>
        <source>Another hot key of Plume&apos;s has this combination already.</source>
        <translation>Un autre raccourci de Plume a déjà cette combinaison.</translation>
    </message>
    <message>
        <source>Another program has this combination as its hot key already: choose another.</source>
        <translation>Un autre programme a déjà cette combinaison pour raccourci&#x202f;: choisissez-en une autre.</translation>
    </message>
    <message>
        <source>The keyboard has no key with code %1 for the hot key.</source>
        <translation>Le clavier n’a pas de touche de code %1 pour le raccourci.</translation>
    </message>
    <message>
        <source>The keyboard &quot;%1&quot; of display &quot;%2&quot; is held by another program, perhaps another Plume or key tool: end that program.</source>
        <translation>Le clavier «&#x202f;%1&#x202f;» de l’affichage «&#x202f;%2&#x202f;» est tenu par un autre programme, peut-être un autre Plume ou un outil de clavier&#x202f;: quittez ce programme.</translation>
    </message>
    <message>
        <source>The X server &quot;%1&quot; lacks the XFIXES extension, which Plume needs to follow the clipboard: switch it on.</source>
        <translation>Il manque au serveur X «&#x202f;%1&#x202f;» l’extension XFIXES, par laquelle Plume suit le presse-papiers&#x202f;: activez-la.</translation>
    </message>
    <message>
        <source>The keyboard layout of the X display &quot;%1&quot; cannot be read: Plume needs an X server with the XKB extension.</source>
        <translation>La disposition du clavier de l’affichage X «&#x202f;%1&#x202f;» est illisible&#x202f;: Plume a besoin d’un serveur X avec l’extension XKB.</translation>
    </message>
    <message>
        <source>The X server of display &quot;%1&quot; lacks an XTEST keyboard on the main keyboard: was it removed with xinput?</source>
        <translation>Il manque au serveur X de l’affichage «&#x202f;%1&#x202f;» un clavier XTEST sur le clavier principal&#x202f;: a-t-il été retiré avec xinput&#x202f;?</translation>
    </message>
    <message>
        <source>The X server of display &quot;%1&quot; lacks %2</source>
        <translation>Il manque au serveur X de l’affichage «&#x202f;%1&#x202f;»&#x202f;: %2</translation>
    </message>
    <message>
        <source>Password fields in browsers</source>
        <translation>Champs de mot de passe des navigateurs</translation>
    </message>
    <message>
        <source>Browsers and Qt programs tell Plume which field takes a password only while the desktop&apos;s accessibility is on, which makes them a little slower; until then Plume hears passwords that are typed there. %1</source>
        <translation>Les navigateurs et les programmes Qt ne disent à Plume quel champ prend un mot de passe que si l’accessibilité du bureau est activée, ce qui les ralentit un peu&#x202f;; d’ici là, Plume entend les mots de passe qui y sont tapés. %1</translation>
    </message>
    <message>
        <source>Your answer is kept; &quot;plume settings %1&quot; shows it.</source>
        <translation>Votre réponse est gardée&#x202f;; «&#x202f;plume settings %1&#x202f;» la montre.</translation>
    </message>
    <message>
        <source>Switch on</source>
        <translation>Activer</translation>
    </message>
    <message>
        <source>Not now</source>
        <translation>Pas maintenant</translation>
    </message>
    <message>
        <source>Programs tell about their password fields now; Chromium has to be started again. %1</source>
        <translation>Les programmes annoncent maintenant leurs champs de mot de passe&#x202f;; Chromium doit être redémarré. %1</translation>
    </message>
    <message>
        <source>The answer is not kept: %1</source>
        <translation>La réponse n’est pas gardée&#x202f;: %1</translation>
    </message>
    <message>
        <source>%1 is %2 from now on.</source>
        <translation>%1 vaut %2 à partir de maintenant.</translation>
    </message>
    <message>
        <source>Several snippets match &quot;%1&quot;, and there is no list here to choose from.</source>
        <translation>Plusieurs extraits répondent à «&#x202f;%1&#x202f;», et il n’y a pas ici de liste pour choisir.</translation>
    </message>
    <message>
        <source>The snippet &quot;%1&quot; has fields to fill in, and there is no form here to do it.</source>
        <translation>L’extrait «&#x202f;%1&#x202f;» a des champs à remplir, et il n’y a pas ici de formulaire pour cela.</translation>
    </message>
    <message>
        <source>The snippet &quot;%1&quot; is not expanded, because its content never ends or is too long; check whether snippets include each other.</source>
        <translation>L’extrait «&#x202f;%1&#x202f;» n’est pas développé, parce que son contenu ne finit jamais ou est trop long&#x202f;; vérifiez si des extraits s’incluent l’un l’autre.</translation>
    </message>
    <message>
        <source>AppleScript snippets cannot run on this system: there is no %1.</source>
        <translation>Les extraits en AppleScript ne peuvent pas fonctionner sur ce système&#x202f;: il n’y a pas de %1.</translation>
    </message>
    <message>
        <source>A script was ended because it wrote more than %1 million characters.</source>
        <translation>Un script a été arrêté parce qu’il écrivait plus de %1 millions de caractères.</translation>
    </message>
    <message>
        <source>A script could not be run: the system gives no further thread.</source>
        <translation>Un script n’a pas pu être lancé&#x202f;: le système n’accorde pas d’autre fil d’exécution.</translation>
    </message>
    <message>
        <source>A script could not be run: %1.</source>
        <translation>Un script n’a pas pu être lancé&#x202f;: %1.</translation>
    </message>
    <message>
        <source>Your library cannot be opened.</source>
        <translation>Votre bibliothèque ne peut pas être ouverte.</translation>
    </message>
    <message>
        <source>The library could not be exported.</source>
        <translation>La bibliothèque n’a pas pu être exportée.</translation>
    </message>
    <message>
        <source>The file could not be restored.</source>
        <translation>Le fichier n’a pas pu être restauré.</translation>
    </message>
    <message>
        <source>The file could not be imported.</source>
        <translation>Le fichier n’a pas pu être importé.</translation>
    </message>
    <message>
        <source>The library was damaged</source>
        <translation>La bibliothèque était endommagée</translation>
    </message>
    <message>
        <source>The library was damaged, and there is no backup of it.</source>
        <translation>La bibliothèque était endommagée, et il n’y en a pas de sauvegarde.</translation>
    </message>
    <message>
        <source>The library was damaged. The newest backup is %1. What could not be read is kept beside it.</source>
        <translation>La bibliothèque était endommagée. La sauvegarde la plus récente est %1. Ce qui n’a pas pu être lu est gardé à côté.</translation>
    </message>
    <message>
        <source>Restore</source>
        <translation>Restaurer</translation>
    </message>
    <message>
        <source>The library cannot be read: %1. It is kept in %2.</source>
        <translation>La bibliothèque ne peut pas être lue&#x202f;: %1. Elle est gardée dans %2.</translation>
    </message>
    <message>
        <source>The last changes of the library cannot be read: %1</source>
        <translation>Les derniers changements de la bibliothèque ne peuvent pas être lus&#x202f;: %1</translation>
    </message>
    <message>
        <source>No backup was made: %1</source>
        <translation>Aucune sauvegarde n’a été faite&#x202f;: %1</translation>
    </message>
    <message>
        <source>An old backup stays: %1</source>
        <translation>Une ancienne sauvegarde reste&#x202f;: %1</translation>
    </message>
    <message>
        <source>nothing was replaced, because the library of now cannot be kept: %1</source>
        <translation>rien n’a été remplacé, parce que la bibliothèque actuelle ne peut pas être gardée&#x202f;: %1</translation>
    </message>
    <message>
        <source>The sync folder %1 is not there; the library is sent when it comes.</source>
        <translation>Le dossier de synchronisation %1 n’est pas là&#x202f;; la bibliothèque sera envoyée quand il viendra.</translation>
    </message>
    <message>
        <source>Another machine had changed the library meanwhile; its version is kept in %1.</source>
        <translation>Une autre machine avait changé la bibliothèque entre-temps&#x202f;; sa version est gardée dans %1.</translation>
    </message>
    <message>
        <source>The library was replaced by another machine&apos;s. What it held, with changes that were not sent yet, is in %1.</source>
        <translation>La bibliothèque a été remplacée par celle d’une autre machine. Ce qu’elle contenait, avec les changements pas encore envoyés, est dans %1.</translation>
    </message>
    <message>
        <source>The library is not sent, because the other one in the sync folder cannot be kept: %1</source>
        <translation>La bibliothèque n’est pas envoyée, parce que l’autre, dans le dossier de synchronisation, ne peut pas être gardée&#x202f;: %1</translation>
    </message>
    <message>
        <source>The library in the sync folder is not taken over, because this machine&apos;s cannot be kept: %1</source>
        <translation>La bibliothèque du dossier de synchronisation n’est pas reprise, parce que celle de cette machine ne peut pas être gardée&#x202f;: %1</translation>
    </message>
    <message>
        <source>The library in the sync folder cannot be read and is left alone: %1</source>
        <translation>La bibliothèque du dossier de synchronisation ne peut pas être lue et reste telle quelle&#x202f;: %1</translation>
    </message>
    <message>
        <source>The library was not sent to the sync folder: another machine writes it all the time</source>
        <translation>La bibliothèque n’a pas été envoyée au dossier de synchronisation&#x202f;: une autre machine l’écrit sans cesse</translation>
    </message>
    <message>
        <source>The library was not sent to the sync folder: %1</source>
        <translation>La bibliothèque n’a pas été envoyée au dossier de synchronisation&#x202f;: %1</translation>
    </message>
    <message>
        <source>%1 cannot be read: %2</source>
        <translation>%1 ne peut pas être lu&#x202f;: %2</translation>
    </message>
    <message>
        <source>%1 cannot be written: %2</source>
        <translation>%1 ne peut pas être écrit&#x202f;: %2</translation>
    </message>
    <message>
        <source>%1 cannot be used: %2</source>
        <translation>%1 ne peut pas être utilisé&#x202f;: %2</translation>
    </message>
    <message>
        <source>A script was ended because it ran longer than %1.</source>
        <translation>Un script a été arrêté parce qu’il durait plus de %1.</translation>
    </message>
    <message>
        <source>1 second</source>
        <translation>1 seconde</translation>
    </message>
    <message>
        <source>%1 seconds</source>
        <translation>%1 secondes</translation>
    </message>
    <message>
        <source>The snippet was not sent: it is no longer in your library.</source>
        <translation>L’extrait n’a pas été envoyé&#x202f;: il n’est plus dans votre bibliothèque.</translation>
    </message>
    <message>
        <source>The snippet was not sent: the window that it was for is gone, or does not take the keyboard.</source>
        <translation>L’extrait n’a pas été envoyé&#x202f;: la fenêtre à laquelle il était destiné a disparu, ou ne prend pas le clavier.</translation>
    </message>
    <message>
        <source>The window that it was for is gone, or does not take the keyboard.</source>
        <translation>La fenêtre à laquelle il était destiné n’existe plus, ou ne prend pas le clavier.</translation>
    </message>
    <message>
        <source>Another field has the focus than the one that it was for.</source>
        <translation>Le champ actif n’est pas celui auquel il était destiné.</translation>
    </message>
    <message>
        <source>A form is shown as a plain window, because no page can be drawn: %1</source>
        <translation>Un formulaire est montré dans une fenêtre simple, faute de pouvoir dessiner une page : %1</translation>
    </message>
    <message>
        <source>the program plume-form is not installed.</source>
        <translation>le programme plume-form n’est pas installé.</translation>
    </message>
    <message>
        <source>The program that draws forms does not answer.</source>
        <translation>Le programme qui dessine les formulaires ne répond pas.</translation>
    </message>
    <message>
        <source>The program that draws forms cannot be started.</source>
        <translation>Le programme qui dessine les formulaires ne peut pas être lancé.</translation>
    </message>
    <message>
        <source>The program that draws forms does not listen.</source>
        <translation>Le programme qui dessine les formulaires n’écoute pas.</translation>
    </message>
    <message>
        <source>The program that draws forms says what cannot be.</source>
        <translation>Le programme qui dessine les formulaires dit ce qui ne peut pas être.</translation>
    </message>
    <message>
        <source>The program that draws forms has crashed.</source>
        <translation>Le programme qui dessine les formulaires s’est arrêté brutalement.</translation>
    </message>
    <message>
        <source>The program that draws forms has ended with %1.</source>
        <translation>Le programme qui dessine les formulaires s’est terminé avec %1.</translation>
    </message>
</context>
<context>
    <name>SnippetRow</name>
    <message>
        <source>Shift+%1</source>
        <translation>Maj+%1</translation>
    </message>
    <message>
        <source>Ctrl+%1</source>
        <translation>Ctrl+%1</translation>
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
        <translation>Collage</translation>
    </message>
    <message>
        <source>&amp;Paste texts instead of typing them</source>
        <translation>&amp;Coller les textes au lieu de les taper</translation>
    </message>
    <message>
        <source>Pasting is faster; typing leaves the clipboard alone.</source>
        <translation>Coller est plus rapide&#x202f;; taper ne touche pas au presse-papiers.</translation>
    </message>
    <message>
        <source>P&amp;aste:</source>
        <translation>C&amp;oller&#x202f;:</translation>
    </message>
    <message>
        <source>Long texts</source>
        <translation>Textes longs</translation>
    </message>
    <message>
        <source>Paste &amp;long texts everywhere</source>
        <translation>Coller les textes &amp;longs partout</translation>
    </message>
    <message>
        <source> character</source>
        <translation> caractère</translation>
    </message>
    <message numerus="yes">
        <source> characters</source>
        <translation>
            <numerusform> caractère</numerusform>
            <numerusform> caractères</numerusform>
        </translation>
    </message>
    <message>
        <source>Long &amp;from:</source>
        <translation>Long à &amp;partir de&#x202f;:</translation>
    </message>
    <message>
        <source>What you copied</source>
        <translation>Ce que vous avez copié</translation>
    </message>
    <message>
        <source>&amp;Give back what was copied after a paste</source>
        <translation>Re&amp;mettre après un collage ce qui était copié</translation>
    </message>
    <message>
        <source>Give it back af&amp;ter:</source>
        <translation>Le remettre &amp;après&#x202f;:</translation>
    </message>
    <message>
        <source>Programs that paste slowly need more.</source>
        <translation>Les programmes qui collent lentement en demandent plus.</translation>
    </message>
</context>
<context>
    <name>plume::AboutWindow</name>
    <message>
        <source>Library</source>
        <translation>Bibliothèque</translation>
    </message>
    <message>
        <source>License</source>
        <translation>Licence</translation>
    </message>
    <message>
        <source>Libraries that Plume uses</source>
        <translation>Bibliothèques que Plume utilise</translation>
    </message>
    <message>
        <source>About Plume</source>
        <translation>À propos de Plume</translation>
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
        <translation>Plume remplace les abréviations que vous tapez par les textes qu’elles représentent, dans tous les programmes.</translation>
    </message>
    <message>
        <source>Plume is free software under the Apache License 2.0; its file LICENSE has the whole text.</source>
        <translation>Plume est un logiciel libre sous la licence Apache 2.0&#x202f;; son fichier LICENSE en contient le texte complet.</translation>
    </message>
    <message>
        <source>Built with these &amp;libraries:</source>
        <translation>Construit avec ces &amp;bibliothèques&#x202f;:</translation>
    </message>
    <message>
        <source>&amp;Close</source>
        <translation>&amp;Fermer</translation>
    </message>
</context>
<context>
    <name>plume::ApplicationList</name>
    <message>
        <source>Remove</source>
        <translation>Supprimer</translation>
    </message>
    <message>
        <source>%1 is in the list already.</source>
        <translation>%1 est déjà dans la liste.</translation>
    </message>
</context>
<context>
    <name>plume::ChipForm</name>
    <message>
        <source>What it gives</source>
        <translation>Ce que cela donne</translation>
    </message>
    <message>
        <source>Warning</source>
        <translation>Avertissement</translation>
    </message>
    <message>
        <source>&amp;Done</source>
        <translation>&amp;Terminé</translation>
    </message>
    <message>
        <source>&amp;Cancel</source>
        <translation>A&amp;nnuler</translation>
    </message>
    <message>
        <source>The sign %1 ends a placeholder and cannot stand in one.</source>
        <translation>Le signe %1 termine une balise et ne peut pas y figurer.</translation>
    </message>
    <message>
        <source>⚠ %1</source>
        <translation>⚠ %1</translation>
    </message>
    <message>
        <source>Can be &amp;left out when the form is filled in</source>
        <translation>Peut être &amp;omis en remplissant le formulaire</translation>
    </message>
    <message>
        <source>Is &amp;ticked at first</source>
        <translation>&amp;Coché au départ</translation>
    </message>
    <message>
        <source>Form:</source>
        <translation>Formulaire&#x202f;:</translation>
    </message>
</context>
<context>
    <name>plume::ChoiceBox</name>
    <message>
        <source>Other (%1)</source>
        <translation>Autre (%1)</translation>
    </message>
</context>
<context>
    <name>plume::ClipboardForm</name>
    <message>
        <source>Clipboard</source>
        <translation>Presse-papiers</translation>
    </message>
    <message>
        <source>&amp;Find:</source>
        <translation>&amp;Rechercher&#x202f;:</translation>
    </message>
    <message>
        <source>&amp;Replace with:</source>
        <translation>Remp&amp;lacer par&#x202f;:</translation>
    </message>
    <message>
        <source>Anywhere</source>
        <translation>N’importe où</translation>
    </message>
    <message>
        <source>At the start of words</source>
        <translation>Au début des mots</translation>
    </message>
    <message>
        <source>Whole words</source>
        <translation>Mots entiers</translation>
    </message>
    <message>
        <source>At the end of words</source>
        <translation>À la fin des mots</translation>
    </message>
    <message>
        <source>Capitals and &amp;small letters differ</source>
        <translation>Distinguer &amp;majuscules et minuscules</translation>
    </message>
    <message>
        <source>Is a regular e&amp;xpression; $1 is its first group</source>
        <translation>E&amp;xpression régulière&#x202f;; $1 est son premier groupe</translation>
    </message>
    <message>
        <source>F&amp;ound:</source>
        <translation>Trou&amp;vé&#x202f;:</translation>
    </message>
    <message>
        <source>What is to be found is no valid pattern, or takes too long. The clipboard&apos;s text stays as it is.</source>
        <translation>Le motif cherché n’est pas valable, ou prend trop de temps. Le texte du presse-papiers reste tel quel.</translation>
    </message>
    <message>
        <source>There is no text in the clipboard now.</source>
        <translation>Il n’y a pas de texte dans le presse-papiers en ce moment.</translation>
    </message>
    <message>
        <source>Gives: %1</source>
        <translation>Donne&#x202f;: %1</translation>
    </message>
</context>
<context>
    <name>plume::ContentEdit</name>
    <message>
        <source>Ctrl+Tab types a tab.</source>
        <translation>Ctrl+Tab insère une tabulation.</translation>
    </message>
    <message>
        <source>Cha&amp;nge…</source>
        <translation>&amp;Modifier…</translation>
    </message>
    <message>
        <source>Cu&amp;t</source>
        <translation>Co&amp;uper</translation>
    </message>
    <message>
        <source>&amp;Copy</source>
        <translation>&amp;Copier</translation>
    </message>
    <message>
        <source>&amp;Paste</source>
        <translation>C&amp;oller</translation>
    </message>
    <message>
        <source>Paste Without &amp;Formatting</source>
        <translation>Coller sans mise en &amp;forme</translation>
    </message>
    <message>
        <source>Select &amp;All</source>
        <translation>&amp;Tout sélectionner</translation>
    </message>
</context>
<context>
    <name>plume::ContentPane</name>
    <message>
        <source>&amp;Insert…</source>
        <translation>&amp;Insérer…</translation>
    </message>
    <message>
        <source>Show So&amp;urce</source>
        <translation>Afficher la so&amp;urce</translation>
    </message>
    <message>
        <source>Content</source>
        <translation>Contenu</translation>
    </message>
    <message>
        <source>Script</source>
        <translation>Script</translation>
    </message>
    <message>
        <source>Insert a date, a field, another snippet… (Ctrl+Space, or type 【)</source>
        <translation>Insérer une date, un champ, un autre extrait… (Ctrl+Espace, ou tapez 【)</translation>
    </message>
    <message>
        <source>Show placeholders as they are written (Ctrl+Shift+U)</source>
        <translation>Montrer les balises telles qu’elles sont écrites (Ctrl+Maj+U)</translation>
    </message>
</context>
<context>
    <name>plume::DateForm</name>
    <message>
        <source>Date</source>
        <translation>Date</translation>
    </message>
    <message>
        <source>From today</source>
        <translation>À partir d’aujourd’hui</translation>
    </message>
    <message>
        <source>The next weekday of this name</source>
        <translation>Le prochain jour de ce nom</translation>
    </message>
    <message>
        <source>The last weekday of this name</source>
        <translation>Le dernier jour de ce nom</translation>
    </message>
    <message>
        <source>The last weekday of this name (%1)</source>
        <translation>Le dernier jour de ce nom (%1)</translation>
    </message>
    <message>
        <source>Years:</source>
        <translation>Années&#x202f;:</translation>
    </message>
    <message>
        <source>Years added</source>
        <translation>Années ajoutées</translation>
    </message>
    <message>
        <source>Months:</source>
        <translation>Mois&#x202f;:</translation>
    </message>
    <message>
        <source>Months added</source>
        <translation>Mois ajoutés</translation>
    </message>
    <message>
        <source>Days:</source>
        <translation>Jours&#x202f;:</translation>
    </message>
    <message>
        <source>Days added</source>
        <translation>Jours ajoutés</translation>
    </message>
    <message>
        <source>Weekday %1</source>
        <translation>Jour de semaine %1</translation>
    </message>
    <message>
        <source>D&amp;ay:</source>
        <translation>&amp;Jour&#x202f;:</translation>
    </message>
    <message>
        <source>Added:</source>
        <translation>Ajout&#x202f;:</translation>
    </message>
    <message>
        <source>&amp;Weekday:</source>
        <translation>Jour de la &amp;semaine&#x202f;:</translation>
    </message>
</context>
<context>
    <name>plume::DateTimeForm</name>
    <message>
        <source>Year</source>
        <translation>Année</translation>
    </message>
    <message>
        <source>Year, two digits</source>
        <translation>Année, deux chiffres</translation>
    </message>
    <message>
        <source>Month</source>
        <translation>Mois</translation>
    </message>
    <message>
        <source>Month, two digits</source>
        <translation>Mois, deux chiffres</translation>
    </message>
    <message>
        <source>Month, abbreviated</source>
        <translation>Mois, abrégé</translation>
    </message>
    <message>
        <source>Month, name</source>
        <translation>Mois, nom</translation>
    </message>
    <message>
        <source>Day</source>
        <translation>Jour</translation>
    </message>
    <message>
        <source>Day, two digits</source>
        <translation>Jour, deux chiffres</translation>
    </message>
    <message>
        <source>Weekday, abbreviated</source>
        <translation>Jour de la semaine, abrégé</translation>
    </message>
    <message>
        <source>Weekday, name</source>
        <translation>Jour de la semaine, nom</translation>
    </message>
    <message>
        <source>Week of the year</source>
        <translation>Semaine de l’année</translation>
    </message>
    <message>
        <source>Day of the year</source>
        <translation>Jour de l’année</translation>
    </message>
    <message>
        <source>Quarter</source>
        <translation>Trimestre</translation>
    </message>
    <message>
        <source>Hour, 00 to 23</source>
        <translation>Heure, 00 à 23</translation>
    </message>
    <message>
        <source>Hour, 1 to 12</source>
        <translation>Heure, 1 à 12</translation>
    </message>
    <message>
        <source>Minute</source>
        <translation>Minute</translation>
    </message>
    <message>
        <source>Second</source>
        <translation>Seconde</translation>
    </message>
    <message>
        <source>Half of the day</source>
        <translation>Matin ou après-midi</translation>
    </message>
    <message>
        <source>Time zone</source>
        <translation>Fuseau horaire</translation>
    </message>
    <message>
        <source>The pattern has letters without a meaning, so nothing is written. Put text between apostrophes.</source>
        <translation>Le modèle a des lettres sans signification&#x202f;: rien n’est donc écrit. Mettez le texte entre apostrophes.</translation>
    </message>
    <message>
        <source>Gives: %1</source>
        <translation>Donne&#x202f;: %1</translation>
    </message>
    <message>
        <source>The pattern is empty.</source>
        <translation>Le modèle est vide.</translation>
    </message>
    <message>
        <source>&amp;Style:</source>
        <translation>St&amp;yle&#x202f;:</translation>
    </message>
    <message>
        <source>&amp;Pattern:</source>
        <translation>&amp;Modèle&#x202f;:</translation>
    </message>
    <message>
        <source>Pattern</source>
        <translation>Modèle</translation>
    </message>
    <message>
        <source>Short: %1</source>
        <translation>Court&#x202f;: %1</translation>
    </message>
    <message>
        <source>Medium: %1</source>
        <translation>Moyen&#x202f;: %1</translation>
    </message>
    <message>
        <source>Long: %1</source>
        <translation>Long&#x202f;: %1</translation>
    </message>
    <message>
        <source>Full: %1</source>
        <translation>Complet&#x202f;: %1</translation>
    </message>
    <message>
        <source>Own pattern</source>
        <translation>Modèle personnel</translation>
    </message>
    <message>
        <source>Letters</source>
        <translation>Lettres</translation>
    </message>
    <message>
        <source>Letters of patterns</source>
        <translation>Lettres des modèles</translation>
    </message>
    <message>
        <source>What letters of a pattern stand for; choosing one puts it in</source>
        <translation>Ce que signifient les lettres d’un modèle&#x202f;; en choisir une l’insère</translation>
    </message>
    <message>
        <source>%1 (%2): %3</source>
        <translation>%1 (%2)&#x202f;: %3</translation>
    </message>
    <message>
        <source>La&amp;nguage:</source>
        <translation>&amp;Langue&#x202f;:</translation>
    </message>
</context>
<context>
    <name>plume::DecisionsWindow</name>
    <message>
        <source>Why Didn&apos;t It Expand?</source>
        <translation>Pourquoi ne s’est-il rien passé&#x202f;?</translation>
    </message>
    <message>
        <source>What became of the abbreviations that you typed last, the newest first. Plume remembers twenty of them until it ends, and nothing else of what you type.</source>
        <translation>Ce que sont devenues les dernières abréviations tapées, la plus récente d’abord. Plume en retient vingt jusqu’à sa fermeture, et rien d’autre de ce que vous tapez.</translation>
    </message>
    <message>
        <source>Abbreviations that you typed last</source>
        <translation>Dernières abréviations tapées</translation>
    </message>
    <message>
        <source>Time</source>
        <translation>Heure</translation>
    </message>
    <message>
        <source>Abbreviation</source>
        <translation>Abréviation</translation>
    </message>
    <message>
        <source>Group</source>
        <translation>Groupe</translation>
    </message>
    <message>
        <source>What happened</source>
        <translation>Ce qui s’est passé</translation>
    </message>
    <message>
        <source>Nothing to tell yet. Type an abbreviation in any program and come back: what became of it stands here then.</source>
        <translation>Rien à raconter pour l’instant. Tapez une abréviation dans un programme et revenez&#x202f;: ce qu’elle est devenue s’affichera ici.</translation>
    </message>
    <message>
        <source>&amp;Forget These</source>
        <translation>&amp;Oublier</translation>
    </message>
    <message>
        <source>&amp;Refresh</source>
        <translation>&amp;Actualiser</translation>
    </message>
</context>
<context>
    <name>plume::DelimitersEdit</name>
    <message>
        <source>The usual ones</source>
        <translation>Les habituels</translation>
    </message>
    <message>
        <source>%1 The usual ones</source>
        <translation>%1 Les habituels</translation>
    </message>
    <message>
        <source>Space</source>
        <translation>Espace</translation>
    </message>
    <message>
        <source>Tab</source>
        <translation>Tab</translation>
    </message>
    <message>
        <source>Return</source>
        <translation>Entrée</translation>
    </message>
    <message>
        <source>Enter</source>
        <translation>Entrée du pavé numérique</translation>
    </message>
    <message>
        <source>%1 %2</source>
        <translation>%1 %2</translation>
    </message>
    <message>
        <source>Others:</source>
        <translation>Autres&#x202f;:</translation>
    </message>
    <message>
        <source>%1 Others</source>
        <translation>%1 Autres</translation>
    </message>
    <message>
        <source>%1 characters</source>
        <translation>%1 caractères</translation>
    </message>
</context>
<context>
    <name>plume::DiagnosticWindow</name>
    <message>
        <source>Plume Diagnostics</source>
        <translation>Diagnostic de Plume</translation>
    </message>
    <message>
        <source>Report</source>
        <translation>Rapport</translation>
    </message>
    <message>
        <source>&amp;Copy</source>
        <translation>&amp;Copier</translation>
    </message>
    <message>
        <source>&amp;Save…</source>
        <translation>&amp;Enregistrer…</translation>
    </message>
    <message>
        <source>This report says how Plume is doing. It holds none of your snippets and nothing that you typed.</source>
        <translation>Ce rapport dit comment va Plume. Il ne contient aucun de vos extraits et rien de ce que vous avez tapé.</translation>
    </message>
    <message>
        <source>The report is on the clipboard.</source>
        <translation>Le rapport est dans le presse-papiers.</translation>
    </message>
    <message>
        <source>Save Report</source>
        <translation>Enregistrer le rapport</translation>
    </message>
    <message>
        <source>Text files (*.txt)</source>
        <translation>Fichiers texte (*.txt)</translation>
    </message>
    <message>
        <source>Plume Report.txt</source>
        <translation>Rapport de Plume.txt</translation>
    </message>
    <message>
        <source>The report was saved.</source>
        <translation>Le rapport a été enregistré.</translation>
    </message>
    <message>
        <source>The report was not saved</source>
        <translation>Le rapport n’a pas été enregistré</translation>
    </message>
</context>
<context>
    <name>plume::FieldControl</name>
    <message>
        <source>%1: %2</source>
        <comment>a field&apos;s name and value</comment>
        <translation>%1&#x202f;: %2</translation>
    </message>
</context>
<context>
    <name>plume::FieldForm</name>
    <message>
        <source>Field of the Form</source>
        <translation>Champ du formulaire</translation>
    </message>
    <message>
        <source>&amp;Name:</source>
        <translation>No&amp;m&#x202f;:</translation>
    </message>
    <message>
        <source>Cannot be &amp;edited in the form</source>
        <translation>Non modifia&amp;ble dans le formulaire</translation>
    </message>
    <message>
        <source>Text in one line</source>
        <translation>Texte sur une ligne</translation>
    </message>
    <message>
        <source>Text in several lines</source>
        <translation>Texte sur plusieurs lignes</translation>
    </message>
    <message>
        <source>Menu to choose from</source>
        <translation>Menu de choix</translation>
    </message>
    <message>
        <source>Number, which can be calculated</source>
        <translation>Nombre, qui peut être calculé</translation>
    </message>
    <message>
        <source>Unknown kind %1</source>
        <translation>Type inconnu %1</translation>
    </message>
    <message>
        <source>&amp;Kind:</source>
        <translation>T&amp;ype&#x202f;:</translation>
    </message>
    <message>
        <source>&amp;Begins with:</source>
        <translation>&amp;Valeur initiale&#x202f;:</translation>
    </message>
    <message>
        <source>C&amp;hoices, one a line:</source>
        <translation>Choi&amp;x, un par ligne&#x202f;:</translation>
    </message>
    <message>
        <source>Chosen at f&amp;irst:</source>
        <translation>Choix au &amp;départ&#x202f;:</translation>
    </message>
    <message>
        <source>As usual</source>
        <translation>Habituelle</translation>
    </message>
    <message>
        <source>&amp;Width in letters:</source>
        <translation>&amp;Largeur en lettres&#x202f;:</translation>
    </message>
    <message>
        <source>Hei&amp;ght in lines:</source>
        <translation>&amp;Hauteur en lignes&#x202f;:</translation>
    </message>
    <message>
        <source>Without a name the form does not say what is asked for.</source>
        <translation>Sans nom, le formulaire ne dit pas ce qui est demandé.</translation>
    </message>
    <message>
        <source>Gives: nothing</source>
        <translation>Donne&#x202f;: rien</translation>
    </message>
    <message>
        <source>A menu without choices is not shown in the form.</source>
        <translation>Un menu sans choix n’est pas montré dans le formulaire.</translation>
    </message>
    <message>
        <source>Gives at first: %1</source>
        <translation>Donne au départ&#x202f;: %1</translation>
    </message>
    <message>
        <source>Gives: what is typed in the form</source>
        <translation>Donne&#x202f;: ce qui est tapé dans le formulaire</translation>
    </message>
</context>
<context>
    <name>plume::FilePanels</name>
    <message>
        <source>The snippets were not exported</source>
        <translation>Les extraits n’ont pas été exportés</translation>
    </message>
    <message>
        <source>%1: snippets can be written to files that end with .plume, .csv or .json.</source>
        <translation>%1&#x202f;: les extraits peuvent être écrits dans des fichiers qui finissent par .plume, .csv ou .json.</translation>
    </message>
    <message>
        <source>Import Snippets</source>
        <translation>Importer des extraits</translation>
    </message>
    <message>
        <source>Snippets of Plume and other programs (%1)</source>
        <translation>Extraits de Plume et d’autres programmes (%1)</translation>
    </message>
    <message>
        <source>All files (*)</source>
        <translation>Tous les fichiers (*)</translation>
    </message>
    <message>
        <source>Choose</source>
        <translation>Choisir</translation>
    </message>
    <message>
        <source>Plume library (*.plume)</source>
        <translation>Bibliothèque de Plume (*.plume)</translation>
    </message>
    <message>
        <source>Comma-separated values (*.csv)</source>
        <translation>Valeurs séparées par des virgules (*.csv)</translation>
    </message>
    <message>
        <source>Readable library (*.json)</source>
        <translation>Bibliothèque lisible (*.json)</translation>
    </message>
    <message>
        <source>Export Snippets</source>
        <translation>Exporter les extraits</translation>
    </message>
    <message>
        <source>Export</source>
        <translation>Exporter</translation>
    </message>
    <message>
        <source>My Snippets</source>
        <translation>Mes extraits</translation>
    </message>
</context>
<context>
    <name>plume::FileUseQuestion</name>
    <message>
        <source>Restore / Import data from %@</source>
        <translation>Restaurer ou importer les données de %@</translation>
    </message>
    <message>
        <source>Restoring will replace all current snippets with snippets from the selected file.<byte value="xd"/>
<byte value="xd"/>
Importing will add file&apos;s snippets to current snippets.</source>
        <translation>Restaurer remplace tous les extraits actuels par ceux du fichier choisi.<byte value="xd"/>
<byte value="xd"/>
Importer ajoute les extraits du fichier aux extraits actuels.</translation>
    </message>
    <message>
        <source>Import</source>
        <translation>Importer</translation>
    </message>
    <message>
        <source>Restore</source>
        <translation>Restaurer</translation>
    </message>
    <message>
        <source>Cancel</source>
        <translation>Annuler</translation>
    </message>
</context>
<context>
    <name>plume::FolderChoice</name>
    <message>
        <source>Default Directory</source>
        <translation>Dossier par défaut</translation>
    </message>
    <message>
        <source>Other Folder…</source>
        <translation>Autre dossier…</translation>
    </message>
    <message>
        <source>Choose a folder</source>
        <translation>Choisir un dossier</translation>
    </message>
    <message>
        <source>Another folder</source>
        <translation>Autre dossier</translation>
    </message>
    <message>
        <source>Choose a Folder</source>
        <translation>Choisir un dossier</translation>
    </message>
</context>
<context>
    <name>plume::FormatBar</name>
    <message>
        <source>Red</source>
        <translation>Rouge</translation>
    </message>
    <message>
        <source>Orange</source>
        <translation>Orange</translation>
    </message>
    <message>
        <source>Yellow</source>
        <translation>Jaune</translation>
    </message>
    <message>
        <source>Green</source>
        <translation>Vert</translation>
    </message>
    <message>
        <source>Blue</source>
        <translation>Bleu</translation>
    </message>
    <message>
        <source>Purple</source>
        <translation>Violet</translation>
    </message>
    <message>
        <source>Gray</source>
        <translation>Gris</translation>
    </message>
    <message>
        <source>Format</source>
        <translation>Format</translation>
    </message>
    <message>
        <source>Font</source>
        <translation>Police</translation>
    </message>
    <message>
        <source>Font size</source>
        <translation>Taille de police</translation>
    </message>
    <message>
        <source>Bold</source>
        <translation>Gras</translation>
    </message>
    <message>
        <source>B</source>
        <comment>sign for bold</comment>
        <translation>G</translation>
    </message>
    <message>
        <source>Italic</source>
        <translation>Italique</translation>
    </message>
    <message>
        <source>I</source>
        <comment>sign for italic</comment>
        <translation>I</translation>
    </message>
    <message>
        <source>Underline</source>
        <translation>Souligné</translation>
    </message>
    <message>
        <source>U</source>
        <comment>sign for underline</comment>
        <translation>S</translation>
    </message>
    <message>
        <source>Strikethrough</source>
        <translation>Barré</translation>
    </message>
    <message>
        <source>S</source>
        <comment>sign for strikethrough</comment>
        <translation>B</translation>
    </message>
    <message>
        <source>Text color</source>
        <translation>Couleur du texte</translation>
    </message>
    <message>
        <source>Color</source>
        <translation>Couleur</translation>
    </message>
    <message>
        <source>Background color</source>
        <translation>Couleur de fond</translation>
    </message>
    <message>
        <source>Marker</source>
        <translation>Surligneur</translation>
    </message>
    <message>
        <source>None</source>
        <comment>color</comment>
        <translation>Aucune</translation>
    </message>
    <message>
        <source>Other…</source>
        <comment>color</comment>
        <translation>Autre…</translation>
    </message>
    <message>
        <source>Bulleted list</source>
        <translation>Liste à puces</translation>
    </message>
    <message>
        <source>Numbered list</source>
        <translation>Liste numérotée</translation>
    </message>
    <message>
        <source>Alignment</source>
        <translation>Alignement</translation>
    </message>
    <message>
        <source>Align</source>
        <translation>Aligner</translation>
    </message>
    <message>
        <source>Left</source>
        <translation>À gauche</translation>
    </message>
    <message>
        <source>Right</source>
        <translation>À droite</translation>
    </message>
    <message>
        <source>Centered</source>
        <translation>Centré</translation>
    </message>
    <message>
        <source>Justified</source>
        <translation>Justifié</translation>
    </message>
    <message>
        <source>Link…</source>
        <translation>Lien…</translation>
    </message>
    <message>
        <source>Link</source>
        <translation>Lien</translation>
    </message>
    <message>
        <source>Picture…</source>
        <translation>Image…</translation>
    </message>
    <message>
        <source>Picture</source>
        <translation>Image</translation>
    </message>
    <message>
        <source>Clear formatting</source>
        <translation>Effacer la mise en forme</translation>
    </message>
    <message>
        <source>Clear</source>
        <translation>Effacer</translation>
    </message>
    <message>
        <source>Address (empty for no link):</source>
        <translation>Adresse (vide pour aucun lien)&#x202f;:</translation>
    </message>
    <message>
        <source>Pictures (*.png *.jpg *.jpeg *.gif *.bmp *.webp *.svg)</source>
        <translation>Images (*.png *.jpg *.jpeg *.gif *.bmp *.webp *.svg)</translation>
    </message>
    <message>
        <source>The picture cannot be inserted.</source>
        <translation>L’image ne peut pas être insérée.</translation>
    </message>
    <message>
        <source>Pictures may have up to 16 MB.</source>
        <translation>Les images peuvent faire jusqu’à 16 Mo.</translation>
    </message>
    <message>
        <source>The file cannot be read as a picture.</source>
        <translation>Le fichier ne peut pas être lu comme une image.</translation>
    </message>
</context>
<context>
    <name>plume::GroupEditor</name>
    <message>
        <source>Enabled</source>
        <translation>Inclus</translation>
    </message>
    <message>
        <source>Ignored</source>
        <translation>Exclus</translation>
    </message>
    <message>
        <source>Name:</source>
        <translation>Nom&#x202f;:</translation>
    </message>
    <message>
        <source>Optional: typed before every abbreviation</source>
        <translation>Facultatif&#x202f;: à taper avant chaque abréviation</translation>
    </message>
    <message>
        <source>Prefix:</source>
        <translation>Préfixe&#x202f;:</translation>
    </message>
    <message>
        <source>Expansion</source>
        <translation>Développement</translation>
    </message>
    <message>
        <source>Expands behind:</source>
        <translation>Se développe après&#x202f;:</translation>
    </message>
    <message>
        <source>A delimiter</source>
        <translation>Un séparateur</translation>
    </message>
    <message>
        <source>White space</source>
        <translation>Une espace ou une nouvelle ligne</translation>
    </message>
    <message>
        <source>Anything, even a letter</source>
        <translation>N’importe quoi, même une lettre</translation>
    </message>
    <message>
        <source>A number</source>
        <translation>Un nombre</translation>
    </message>
    <message>
        <source>Delimiters before it:</source>
        <translation>Séparateurs avant&#x202f;:</translation>
    </message>
    <message>
        <source>Expands:</source>
        <translation>Se développe&#x202f;:</translation>
    </message>
    <message>
        <source>At once, with its last character</source>
        <translation>Aussitôt, au dernier caractère</translation>
    </message>
    <message>
        <source>With a delimiter, which stays</source>
        <translation>Par un séparateur, qui reste</translation>
    </message>
    <message>
        <source>With a delimiter, which is left out</source>
        <translation>Par un séparateur, qui ne reste pas</translation>
    </message>
    <message>
        <source>Never by typing</source>
        <translation>Jamais à la frappe</translation>
    </message>
    <message>
        <source>With the hot key that expands</source>
        <translation>Par le raccourci clavier qui développe</translation>
    </message>
    <message>
        <source>Delimiters behind it:</source>
        <translation>Séparateurs après&#x202f;:</translation>
    </message>
    <message>
        <source>Offer as suggestions</source>
        <translation>Proposer dans les suggestions</translation>
    </message>
    <message>
        <source>List in the menu</source>
        <translation>Afficher dans le menu</translation>
    </message>
    <message>
        <source>Reset the formatting behind a formatted text</source>
        <translation>Rétablir la mise en forme après un texte mis en forme</translation>
    </message>
    <message>
        <source>Letter case</source>
        <translation>Casse</translation>
    </message>
    <message>
        <source>New snippets:</source>
        <translation>Nouveaux extraits&#x202f;:</translation>
    </message>
    <message>
        <source>Letter case of new snippets</source>
        <translation>Casse des nouveaux extraits</translation>
    </message>
    <message>
        <source>Reset…</source>
        <translation>Réinitialiser…</translation>
    </message>
    <message>
        <source>Reset the letter case of all snippets</source>
        <translation>Réinitialiser la casse de tous les extraits</translation>
    </message>
    <message>
        <source>All snippets:</source>
        <translation>Tous les extraits&#x202f;:</translation>
    </message>
    <message>
        <source>Where</source>
        <translation>Où</translation>
    </message>
    <message>
        <source>Programs:</source>
        <translation>Programmes&#x202f;:</translation>
    </message>
    <message>
        <source>In all programs</source>
        <translation>Dans tous les programmes</translation>
    </message>
    <message>
        <source>In all programs except those below</source>
        <translation>Dans tous les programmes sauf ceux-ci</translation>
    </message>
    <message>
        <source>Only in the programs below</source>
        <translation>Seulement dans les programmes ci-dessous</translation>
    </message>
    <message>
        <source>Keyboard layouts:</source>
        <translation>Dispositions de clavier&#x202f;:</translation>
    </message>
</context>
<context>
    <name>plume::HotKeyRecorder</name>
    <message>
        <source>Ctrl</source>
        <translation>Ctrl</translation>
    </message>
    <message>
        <source>Alt</source>
        <translation>Alt</translation>
    </message>
    <message>
        <source>Shift</source>
        <translation>Maj</translation>
    </message>
    <message>
        <source>Super</source>
        <translation>Super</translation>
    </message>
    <message>
        <source>Key %1</source>
        <translation>Touche %1</translation>
    </message>
    <message>
        <source>Clear</source>
        <translation>Effacer</translation>
    </message>
    <message>
        <source>Nothing was heard. Plume may not hear the keyboard at the moment.</source>
        <translation>Rien n’a été entendu. Plume n’entend peut-être pas le clavier en ce moment.</translation>
    </message>
    <message>
        <source>Clear the hot key: %1</source>
        <translation>Effacer le raccourci clavier&#x202f;: %1</translation>
    </message>
    <message>
        <source>%1 would be typed all the time. Hold Ctrl, Alt or Super with it.</source>
        <translation>%1 serait tapé sans cesse. Ajoutez Ctrl, Alt ou Super.</translation>
    </message>
    <message>
        <source>%1 is the hot key of “%2” already.</source>
        <translation>%1 est déjà le raccourci clavier de «&#x202f;%2&#x202f;».</translation>
    </message>
    <message>
        <source>Press keys… Escape leaves it as it is</source>
        <translation>Touches… Échap pour annuler</translation>
    </message>
    <message>
        <source>None</source>
        <translation>Aucun</translation>
    </message>
</context>
<context>
    <name>plume::ImportModel</name>
    <message>
        <source>No snippets</source>
        <translation>Aucun extrait</translation>
    </message>
    <message>
        <source>1 snippet</source>
        <translation>1 extrait</translation>
    </message>
    <message numerus="yes">
        <source>%n snippets</source>
        <translation>
            <numerusform>%n extrait</numerusform>
            <numerusform>%n extraits</numerusform>
        </translation>
    </message>
    <message>
        <source>Group, Abbreviation</source>
        <translation>Groupe, abréviation</translation>
    </message>
    <message>
        <source>Content</source>
        <translation>Contenu</translation>
    </message>
    <message>
        <source>In Your Library</source>
        <translation>Dans votre bibliothèque</translation>
    </message>
    <message>
        <source>Takes the place of your group of this name</source>
        <translation>Remplace votre groupe de ce nom</translation>
    </message>
    <message>
        <source>All of it is there already</source>
        <translation>Tout y est déjà</translation>
    </message>
    <message>
        <source>1 is there already</source>
        <translation>1 y est déjà</translation>
    </message>
    <message numerus="yes">
        <source>%n are there already</source>
        <translation>
            <numerusform>%n y est déjà</numerusform>
            <numerusform>%n y sont déjà</numerusform>
        </translation>
    </message>
    <message>
        <source>1 abbreviation is taken</source>
        <translation>1 abréviation est prise</translation>
    </message>
    <message numerus="yes">
        <source>%n abbreviations are taken</source>
        <translation>
            <numerusform>%n abréviation est prise</numerusform>
            <numerusform>%n abréviations sont prises</numerusform>
        </translation>
    </message>
    <message>
        <source>Comes twice, also in “%1”</source>
        <translation>Figure deux fois, aussi dans «&#x202f;%1&#x202f;»</translation>
    </message>
    <message>
        <source>Is there already, in “%1”</source>
        <translation>Existe déjà, dans «&#x202f;%1&#x202f;»</translation>
    </message>
    <message>
        <source>Is taken by another one in “%1”</source>
        <translation>Est prise par un autre dans «&#x202f;%1&#x202f;»</translation>
    </message>
</context>
<context>
    <name>plume::ImportWindow</name>
    <message>
        <source>Convert the &amp;placeholders of TextExpander</source>
        <translation>Convertir les &amp;balises de TextExpander</translation>
    </message>
    <message>
        <source>What cannot be carried over &amp;whole:</source>
        <translation>Ce qui ne peut pas être repris en &amp;entier&#x202f;:</translation>
    </message>
    <message>
        <source>Import Snippets</source>
        <translation>Importer des extraits</translation>
    </message>
    <message>
        <source>Groups and snippets in the file</source>
        <translation>Groupes et extraits du fichier</translation>
    </message>
    <message>
        <source>What cannot be carried over whole</source>
        <translation>Ce qui ne peut pas être repris en entier</translation>
    </message>
    <message>
        <source>Reading</source>
        <translation>Lecture</translation>
    </message>
    <message>
        <source>&amp;Import</source>
        <translation>&amp;Importer</translation>
    </message>
    <message>
        <source>Cancel</source>
        <translation>Annuler</translation>
    </message>
    <message>
        <source>Reading “%1”…</source>
        <translation>Lecture de «&#x202f;%1&#x202f;»…</translation>
    </message>
    <message>
        <source>Nothing can be imported from “%1”</source>
        <translation>Rien ne peut être importé de «&#x202f;%1&#x202f;»</translation>
    </message>
    <message>
        <source>There are no snippets in “%1”</source>
        <translation>Il n’y a aucun extrait dans «&#x202f;%1&#x202f;»</translation>
    </message>
    <message>
        <source>Close</source>
        <translation>Fermer</translation>
    </message>
    <message>
        <source>in 1 group</source>
        <translation>dans 1 groupe</translation>
    </message>
    <message numerus="yes">
        <source>in %n groups</source>
        <translation>
            <numerusform>dans %n groupe</numerusform>
            <numerusform>dans %n groupes</numerusform>
        </translation>
    </message>
    <message>
        <source>1 snippet</source>
        <translation>1 extrait</translation>
    </message>
    <message numerus="yes">
        <source>%n snippets</source>
        <translation>
            <numerusform>%n extrait</numerusform>
            <numerusform>%n extraits</numerusform>
        </translation>
    </message>
    <message>
        <source>“%1”: %2 %3</source>
        <extracomment>The file&apos;s name, &quot;12 snippets&quot;, &quot;in 2 groups&quot;.</extracomment>
        <translation>«&#x202f;%1&#x202f;»&#x202f;: %2 %3</translation>
    </message>
    <message>
        <source>&amp;Import 1 Group</source>
        <translation>&amp;Importer 1 groupe</translation>
    </message>
    <message numerus="yes">
        <source>&amp;Import %n Groups</source>
        <translation>
            <numerusform>&amp;Importer %n groupe</numerusform>
            <numerusform>&amp;Importer %n groupes</numerusform>
        </translation>
    </message>
</context>
<context>
    <name>plume::InitalSyncWindowController</name>
    <message>
        <source>Synchronize Snippets</source>
        <translation>Synchroniser les extraits</translation>
    </message>
    <message>
        <source>Use the snippets in “%@” on this computer</source>
        <translation>Utiliser les extraits de «&#x202f;%@&#x202f;» sur cet ordinateur</translation>
    </message>
    <message>
        <source>Replace the snippets in “%@” by those of this computer</source>
        <translation>Remplacer les extraits de «&#x202f;%@&#x202f;» par ceux de cet ordinateur</translation>
    </message>
    <message>
        <source>The folder “%@” holds snippets already</source>
        <translation>Le dossier «&#x202f;%@&#x202f;» contient déjà des extraits</translation>
    </message>
    <message>
        <source>&amp;Cancel</source>
        <translation>A&amp;nnuler</translation>
    </message>
    <message>
        <source>Which snippets do you want to keep?</source>
        <translation>Quels extraits voulez-vous garder&#x202f;?</translation>
    </message>
    <message>
        <source>The snippets that are replaced are not lost: Plume writes a backup of them first.</source>
        <translation>Les extraits remplacés ne sont pas perdus&#x202f;: Plume les sauvegarde d’abord.</translation>
    </message>
    <message>
        <source>&amp;Use Folder’s Snippets</source>
        <translation>&amp;Utiliser les extraits du dossier</translation>
    </message>
    <message>
        <source>&amp;Replace Folder’s Snippets</source>
        <translation>&amp;Remplacer les extraits du dossier</translation>
    </message>
</context>
<context>
    <name>plume::InputSourcesEdit</name>
    <message>
        <source>With all layouts</source>
        <translation>Avec toutes les dispositions</translation>
    </message>
    <message>
        <source>With all layouts except those checked below</source>
        <translation>Avec toutes les dispositions sauf celles cochées ci-dessous</translation>
    </message>
    <message>
        <source>Only with the layouts checked below</source>
        <translation>Seulement avec les dispositions cochées ci-dessous</translation>
    </message>
    <message>
        <source>Keyboard layouts</source>
        <translation>Dispositions de clavier</translation>
    </message>
    <message>
        <source>Chosen keyboard layouts</source>
        <translation>Dispositions de clavier choisies</translation>
    </message>
    <message>
        <source>Another layout</source>
        <translation>Autre disposition</translation>
    </message>
    <message>
        <source>Another layout, like “de(nodeadkeys)”</source>
        <translation>Autre disposition, comme «&#x202f;de(nodeadkeys)&#x202f;»</translation>
    </message>
    <message>
        <source>Add Layout</source>
        <translation>Ajouter la disposition</translation>
    </message>
</context>
<context>
    <name>plume::InsertMenu</name>
    <message>
        <source>Nothing was found.</source>
        <translation>Rien n’a été trouvé.</translation>
    </message>
    <message>
        <source>Insert</source>
        <translation>Insérer</translation>
    </message>
    <message>
        <source>Search what to insert</source>
        <translation>Chercher quoi insérer</translation>
    </message>
    <message>
        <source>What can be inserted</source>
        <translation>Ce qui peut être inséré</translation>
    </message>
</context>
<context>
    <name>plume::KeyForm</name>
    <message>
        <source>Return</source>
        <translation>Entrée</translation>
    </message>
    <message>
        <source>Tab</source>
        <translation>Tab</translation>
    </message>
    <message>
        <source>Escape</source>
        <translation>Échap</translation>
    </message>
    <message>
        <source>Space</source>
        <translation>Espace</translation>
    </message>
    <message>
        <source>Backspace</source>
        <translation>Retour arrière</translation>
    </message>
    <message>
        <source>Delete</source>
        <translation>Suppr</translation>
    </message>
    <message>
        <source>Left</source>
        <translation>Gauche</translation>
    </message>
    <message>
        <source>Right</source>
        <translation>Droite</translation>
    </message>
    <message>
        <source>Up</source>
        <translation>Haut</translation>
    </message>
    <message>
        <source>Down</source>
        <translation>Bas</translation>
    </message>
    <message>
        <source>Home</source>
        <translation>Début</translation>
    </message>
    <message>
        <source>End</source>
        <translation>Fin</translation>
    </message>
    <message>
        <source>Page Up</source>
        <translation>Page précédente</translation>
    </message>
    <message>
        <source>Page Down</source>
        <translation>Page suivante</translation>
    </message>
    <message>
        <source>Enter of the keypad</source>
        <translation>Entrée du pavé numérique</translation>
    </message>
    <message>
        <source>Insert</source>
        <translation>Inser</translation>
    </message>
    <message>
        <source>Key</source>
        <translation>Touche</translation>
    </message>
    <message>
        <source>Nothing was heard. Plume may not hear the keyboard at the moment.</source>
        <translation>Rien n’a été entendu. Plume n’entend peut-être pas le clavier en ce moment.</translation>
    </message>
    <message>
        <source>No key</source>
        <translation>Aucune touche</translation>
    </message>
    <message>
        <source>Key %1</source>
        <translation>Touche %1</translation>
    </message>
    <message>
        <source>&amp;Record</source>
        <translation>Ca&amp;pturer</translation>
    </message>
    <message>
        <source>Takes the next key that is pressed</source>
        <translation>Prend la prochaine touche enfoncée</translation>
    </message>
    <message>
        <source>&amp;Key:</source>
        <translation>To&amp;uche&#x202f;:</translation>
    </message>
    <message>
        <source>Held with it:</source>
        <translation>Tenues avec elle&#x202f;:</translation>
    </message>
    <message>
        <source>Ctr&amp;l</source>
        <translation>Ctr&amp;l</translation>
    </message>
    <message>
        <source>&amp;Alt</source>
        <translation>&amp;Alt</translation>
    </message>
    <message>
        <source>&amp;Shift</source>
        <translation>&amp;Maj</translation>
    </message>
    <message>
        <source>S&amp;uper</source>
        <translation>&amp;Super</translation>
    </message>
    <message>
        <source>Not at all</source>
        <translation>Aucun</translation>
    </message>
    <message>
        <source>seconds</source>
        <translation>secondes</translation>
    </message>
    <message>
        <source>&amp;Times pressed:</source>
        <translation>Nombre de &amp;frappes&#x202f;:</translation>
    </message>
    <message>
        <source>&amp;Waits before:</source>
        <translation>&amp;Délai avant&#x202f;:</translation>
    </message>
    <message>
        <source>Presses no key.</source>
        <translation>N’appuie sur aucune touche.</translation>
    </message>
    <message>
        <source>Presses %1</source>
        <translation>Appuie sur %1</translation>
    </message>
    <message>
        <source>%1, %2 times</source>
        <translation>%1, %2 fois</translation>
    </message>
    <message>
        <source>%1, after %2 seconds</source>
        <translation>%1, après %2 secondes</translation>
    </message>
    <message>
        <source>Press a key… (Escape ends)</source>
        <translation>Appuyez sur une touche… (Échap pour annuler)</translation>
    </message>
</context>
<context>
    <name>plume::LibraryExportWindow</name>
    <message>
        <source>Plume library (*.plume)</source>
        <translation>Bibliothèque de Plume (*.plume)</translation>
    </message>
    <message>
        <source>Comma-separated values (*.csv)</source>
        <translation>Valeurs séparées par des virgules (*.csv)</translation>
    </message>
    <message>
        <source>Readable library (*.json)</source>
        <translation>Bibliothèque lisible (*.json)</translation>
    </message>
    <message>
        <source>Rich text, to read and print (*.rtf)</source>
        <translation>Texte mis en forme, à lire et imprimer (*.rtf)</translation>
    </message>
    <message>
        <source>Export</source>
        <translation>Exporter</translation>
    </message>
    <message>
        <source>The snippets were not exported</source>
        <translation>Les extraits n’ont pas été exportés</translation>
    </message>
    <message>
        <source>Export All Snippets</source>
        <translation>Exporter tous les extraits</translation>
    </message>
    <message>
        <source>My Snippets</source>
        <translation>Mes extraits</translation>
    </message>
    <message>
        <source>Export the Group “%1”</source>
        <translation>Exporter le groupe «&#x202f;%1&#x202f;»</translation>
    </message>
    <message>
        <source>Export the Selected Snippets</source>
        <translation>Exporter les extraits sélectionnés</translation>
    </message>
    <message>
        <source>Selected Snippets</source>
        <translation>Extraits sélectionnés</translation>
    </message>
</context>
<context>
    <name>plume::LocaleChoice</name>
    <message>
        <source>Yours</source>
        <translation>La vôtre</translation>
    </message>
</context>
<context>
    <name>plume::MacrosWindowController</name>
    <message>
        <source>&amp;File</source>
        <translation>&amp;Fichier</translation>
    </message>
    <message>
        <source>&amp;Edit</source>
        <translation>É&amp;dition</translation>
    </message>
    <message>
        <source>&amp;Library</source>
        <translation>&amp;Bibliothèque</translation>
    </message>
    <message>
        <source>&amp;New Snippet</source>
        <translation>&amp;Nouvel extrait</translation>
    </message>
    <message>
        <source>New Snippet from Clip&amp;board</source>
        <translation>Nouvel extrait du &amp;presse-papiers</translation>
    </message>
    <message>
        <source>New &amp;Group</source>
        <translation>Nouveau &amp;groupe</translation>
    </message>
    <message>
        <source>&amp;Import…</source>
        <translation>&amp;Importer…</translation>
    </message>
    <message>
        <source>&amp;Export</source>
        <translation>&amp;Exporter</translation>
    </message>
    <message>
        <source>&amp;Preferences…</source>
        <translation>Pré&amp;férences…</translation>
    </message>
    <message>
        <source>&amp;Close</source>
        <translation>Fer&amp;mer</translation>
    </message>
    <message>
        <source>&amp;Quit Plume</source>
        <translation>&amp;Quitter Plume</translation>
    </message>
    <message>
        <source>&amp;Undo %1</source>
        <translation>&amp;Annuler&#x202f;: %1</translation>
    </message>
    <message>
        <source>&amp;Undo</source>
        <translation>&amp;Annuler</translation>
    </message>
    <message>
        <source>&amp;Redo %1</source>
        <translation>&amp;Rétablir&#x202f;: %1</translation>
    </message>
    <message>
        <source>&amp;Redo</source>
        <translation>&amp;Rétablir</translation>
    </message>
    <message>
        <source>Cu&amp;t</source>
        <translation>Co&amp;uper</translation>
    </message>
    <message>
        <source>&amp;Copy</source>
        <translation>&amp;Copier</translation>
    </message>
    <message>
        <source>&amp;Paste</source>
        <translation>C&amp;oller</translation>
    </message>
    <message>
        <source>Select &amp;All</source>
        <translation>&amp;Tout sélectionner</translation>
    </message>
    <message>
        <source>&amp;Duplicate</source>
        <translation>&amp;Dupliquer</translation>
    </message>
    <message>
        <source>De&amp;lete</source>
        <translation>&amp;Supprimer</translation>
    </message>
    <message>
        <source>Rena&amp;me</source>
        <translation>Reno&amp;mmer</translation>
    </message>
    <message>
        <source>&amp;Find</source>
        <translation>Rec&amp;hercher</translation>
    </message>
    <message>
        <source>&amp;Sort Snippets</source>
        <translation>Trier les e&amp;xtraits</translation>
    </message>
    <message>
        <source>Sort &amp;Groups</source>
        <translation>Trier les &amp;groupes</translation>
    </message>
    <message>
        <source>&amp;Add</source>
        <translation>A&amp;jouter</translation>
    </message>
    <message>
        <source>&amp;Delete Duplicated Snippets…</source>
        <translation>Supprimer les &amp;doublons…</translation>
    </message>
    <message>
        <source>&amp;None</source>
        <translation>Aucu&amp;n</translation>
    </message>
    <message>
        <source>By &amp;Abbreviation</source>
        <translation>Par &amp;abréviation</translation>
    </message>
    <message>
        <source>By &amp;Label or Content</source>
        <translation>Par &amp;libellé ou contenu</translation>
    </message>
    <message>
        <source>By Date &amp;Created</source>
        <translation>Par date de &amp;création</translation>
    </message>
    <message>
        <source>By Date C&amp;hanged</source>
        <translation>Par date de &amp;modification</translation>
    </message>
    <message>
        <source>By Last &amp;Use</source>
        <translation>Par dernière &amp;utilisation</translation>
    </message>
    <message>
        <source>AutoCorrect Dictionary (%1)</source>
        <translation>Dictionnaire de correction automatique (%1)</translation>
    </message>
    <message>
        <source>&amp;Selection…</source>
        <translation>&amp;Sélection…</translation>
    </message>
    <message>
        <source>&amp;Group…</source>
        <translation>&amp;Groupe…</translation>
    </message>
    <message>
        <source>&amp;All Groups…</source>
        <translation>&amp;Tous les groupes…</translation>
    </message>
    <message>
        <source>Nothing was added.</source>
        <translation>Rien n’a été ajouté.</translation>
    </message>
    <message>
        <source>My Snippets</source>
        <translation>Mes extraits</translation>
    </message>
    <message>
        <source>New Group</source>
        <translation>Nouveau groupe</translation>
    </message>
    <message>
        <source>There are no duplicated snippets.</source>
        <translation>Il n’y a pas d’extraits en double.</translation>
    </message>
    <message>
        <source>Duplicated are snippets with the same abbreviation and the same content.</source>
        <translation>Sont en double les extraits qui ont la même abréviation et le même contenu.</translation>
    </message>
    <message>
        <source>Are you sure you want to delete all (#) duplicated snippets?</source>
        <translation>Voulez-vous vraiment supprimer les (#) extraits en double&#x202f;?</translation>
    </message>
    <message>
        <source>One of each stays. Undo brings them back as long as this window is open.</source>
        <translation>Il en reste un de chaque. Annuler les ramène tant que cette fenêtre est ouverte.</translation>
    </message>
    <message>
        <source>Delete</source>
        <translation>Supprimer</translation>
    </message>
    <message>
        <source>What the clipboard has could not be read: %1</source>
        <translation>Le contenu du presse-papiers n’a pas pu être lu&#x202f;: %1</translation>
    </message>
    <message>
        <source>Snippets</source>
        <translation>Extraits</translation>
    </message>
    <message>
        <source>Notice</source>
        <translation>Avis</translation>
    </message>
    <message>
        <source>This snippet is no longer in the library.</source>
        <translation>Cet extrait n’est plus dans la bibliothèque.</translation>
    </message>
    <message>
        <source>There are no snippets yet. Choose New Snippet in the menu File, or press Ctrl+N.</source>
        <translation>Il n’y a pas encore d’extraits. Choisissez Nouvel extrait dans le menu Fichier, ou appuyez sur Ctrl+N.</translation>
    </message>
    <message>
        <source>Select a snippet to see and change it.</source>
        <translation>Sélectionnez un extrait pour le voir et le modifier.</translation>
    </message>
    <message>
        <source>Several rows are selected: they can be moved, copied, duplicated and deleted.</source>
        <translation>Plusieurs lignes sont sélectionnées&#x202f;: elles peuvent être déplacées, copiées, dupliquées et supprimées.</translation>
    </message>
    <message>
        <source>Your snippets were changed elsewhere meanwhile: this can no longer be undone.</source>
        <translation>Vos extraits ont été modifiés ailleurs entre-temps&#x202f;: cela ne peut plus être annulé.</translation>
    </message>
    <message>
        <source>Your snippets were changed elsewhere and are shown as they are now.</source>
        <translation>Vos extraits ont été modifiés ailleurs et sont montrés dans leur état actuel.</translation>
    </message>
    <message>
        <source>Your snippets were changed elsewhere. What you were just editing was kept.</source>
        <translation>Vos extraits ont été modifiés ailleurs. Ce que vous étiez en train de modifier a été gardé.</translation>
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
        <translation>Annuler</translation>
    </message>
</context>
<context>
    <name>plume::NewSnippetWindow</name>
    <message>
        <source>New Snippet</source>
        <translation>Nouvel extrait</translation>
    </message>
    <message>
        <source>My Snippets</source>
        <translation>Mes extraits</translation>
    </message>
    <message>
        <source>Add &amp;Snippet</source>
        <translation>Ajouter l’&amp;extrait</translation>
    </message>
    <message>
        <source>&amp;Cancel</source>
        <translation>An&amp;nuler</translation>
    </message>
    <message>
        <source>Optional: a name for lists</source>
        <translation>Facultatif&#x202f;: un nom pour les listes</translation>
    </message>
    <message>
        <source>About the abbreviation</source>
        <translation>Au sujet de l’abréviation</translation>
    </message>
    <message>
        <source>&amp;Group:</source>
        <translation>&amp;Groupe&#x202f;:</translation>
    </message>
    <message>
        <source>Na&amp;me of group:</source>
        <translation>No&amp;m du groupe&#x202f;:</translation>
    </message>
    <message>
        <source>&amp;Abbreviation:</source>
        <translation>&amp;Abréviation&#x202f;:</translation>
    </message>
    <message>
        <source>&amp;Label:</source>
        <translation>&amp;Libellé&#x202f;:</translation>
    </message>
    <message>
        <source>&amp;Text:</source>
        <translation>&amp;Texte&#x202f;:</translation>
    </message>
    <message>
        <source>Untitled group</source>
        <translation>Groupe sans nom</translation>
    </message>
    <message>
        <source>New Group…</source>
        <translation>Nouveau groupe…</translation>
    </message>
    <message>
        <source>Without an abbreviation it can only be chosen from lists.</source>
        <translation>Sans abréviation, seules les listes y mènent.</translation>
    </message>
    <message>
        <source>The group has this abbreviation already. Both will be kept.</source>
        <translation>Déjà dans ce groupe. Les deux seront gardées.</translation>
    </message>
    <message>
        <source>Do you want to throw this snippet away?</source>
        <translation>Voulez-vous abandonner cet extrait&#x202f;?</translation>
    </message>
    <message>
        <source>It was not added to your snippets yet.</source>
        <translation>Il n’a pas encore été ajouté à vos extraits.</translation>
    </message>
    <message>
        <source>Throw Away</source>
        <translation>Abandonner</translation>
    </message>
</context>
<context>
    <name>plume::OutlineModel</name>
    <message>
        <source>Untitled group</source>
        <translation>Groupe sans nom</translation>
    </message>
    <message>
        <source>Off</source>
        <translation>Désactivé</translation>
    </message>
    <message>
        <source>Duplicate</source>
        <translation>Doublon</translation>
    </message>
    <message>
        <source>Script</source>
        <translation>Script</translation>
    </message>
    <message>
        <source>Formatted</source>
        <translation>Mis en forme</translation>
    </message>
</context>
<context>
    <name>plume::OutlinePane</name>
    <message>
        <source>&amp;Search By</source>
        <translation>Chercher da&amp;ns</translation>
    </message>
    <message>
        <source>Nothing was found.</source>
        <translation>Rien n’a été trouvé.</translation>
    </message>
    <message>
        <source>Search</source>
        <translation>Rechercher</translation>
    </message>
    <message>
        <source>Search in the snippets</source>
        <translation>Rechercher dans les extraits</translation>
    </message>
    <message>
        <source>What is searched</source>
        <translation>Ce qui est parcouru</translation>
    </message>
    <message>
        <source>&amp;Abbreviation</source>
        <translation>Les &amp;abréviations</translation>
    </message>
    <message>
        <source>&amp;Label</source>
        <translation>Les &amp;libellés</translation>
    </message>
    <message>
        <source>&amp;Content</source>
        <translation>Les &amp;contenus</translation>
    </message>
    <message>
        <source>&amp;Wildcards: * and ?</source>
        <translation>Les &amp;jokers : * et ?</translation>
    </message>
</context>
<context>
    <name>plume::OutlineView</name>
    <message>
        <source>Groups and snippets</source>
        <translation>Groupes et extraits</translation>
    </message>
</context>
<context>
    <name>plume::PlainFormWindow</name>
    <message>
        <source>Text of the snippet</source>
        <translation>Texte de l’extrait</translation>
    </message>
    <message>
        <source>Field %1</source>
        <translation>Champ %1</translation>
    </message>
</context>
<context>
    <name>plume::PreferencesPage</name>
    <message>
        <source>This could not be kept. %1</source>
        <translation>Cela n’a pas pu être enregistré. %1</translation>
    </message>
    <message>
        <source>Another value (%1)</source>
        <translation>Autre valeur (%1)</translation>
    </message>
    <message>
        <source> seconds</source>
        <translation> s</translation>
    </message>
    <message>
        <source>In all programs</source>
        <translation>Dans tous les programmes</translation>
    </message>
    <message>
        <source>In all programs except those below</source>
        <translation>Dans tous les programmes sauf ceux-ci</translation>
    </message>
    <message>
        <source>Only in the programs below</source>
        <translation>Seulement dans les programmes ci-dessous</translation>
    </message>
    <message>
        <source>Programs</source>
        <translation>Programmes</translation>
    </message>
    <message>
        <source>Enabled</source>
        <translation>Inclus</translation>
    </message>
    <message>
        <source>Ignored</source>
        <translation>Exclus</translation>
    </message>
</context>
<context>
    <name>plume::PreferencesWindow</name>
    <message>
        <source>Preferences</source>
        <translation>Préférences</translation>
    </message>
    <message>
        <source>General</source>
        <translation>Général</translation>
    </message>
    <message>
        <source>Expansion</source>
        <translation>Développement</translation>
    </message>
    <message>
        <source>Suggestions and search</source>
        <translation>Suggestions et recherche</translation>
    </message>
    <message>
        <source>Typing and clipboard</source>
        <translation>Saisie et presse-papiers</translation>
    </message>
    <message>
        <source>Correction</source>
        <translation>Correction</translation>
    </message>
    <message>
        <source>Hot keys</source>
        <translation>Raccourcis clavier</translation>
    </message>
    <message>
        <source>Applications</source>
        <translation>Programmes</translation>
    </message>
    <message>
        <source>Backups and sync</source>
        <translation>Sauvegardes et synchro</translation>
    </message>
    <message>
        <source>Import and export</source>
        <translation>Import et export</translation>
    </message>
    <message>
        <source>Advanced</source>
        <translation>Avancé</translation>
    </message>
    <message>
        <source>Search settings</source>
        <translation>Rechercher un réglage</translation>
    </message>
    <message>
        <source>Pages</source>
        <translation>Pages</translation>
    </message>
    <message>
        <source>Settings that were found</source>
        <translation>Réglages trouvés</translation>
    </message>
    <message>
        <source>Nothing was found.</source>
        <translation>Rien n’a été trouvé.</translation>
    </message>
    <message>
        <source>What went wrong</source>
        <translation>Ce qui n’a pas marché</translation>
    </message>
    <message>
        <source>Hide</source>
        <translation>Masquer</translation>
    </message>
    <message>
        <source>Restore &amp;Defaults</source>
        <translation>&amp;Rétablir les valeurs par défaut</translation>
    </message>
    <message>
        <source>Restore the defaults of the page “%1”?</source>
        <translation>Rétablir les valeurs par défaut de la page «&#x202f;%1&#x202f;»&#x202f;?</translation>
    </message>
    <message>
        <source>What you have set on this page is forgotten. Other pages stay as they are.</source>
        <translation>Ce que vous avez réglé sur cette page est oublié. Les autres pages restent comme elles sont.</translation>
    </message>
    <message>
        <source>&amp;Restore Defaults</source>
        <translation>&amp;Rétablir les valeurs par défaut</translation>
    </message>
</context>
<context>
    <name>plume::PreviewPane</name>
    <message>
        <source>Included by</source>
        <translation>Inclus par</translation>
    </message>
    <message>
        <source>Try abbreviations here: they expand.</source>
        <translation>Essayez des abréviations ici&#x202f;: elles se développent.</translation>
    </message>
    <message>
        <source>Field to try abbreviations in</source>
        <translation>Champ pour essayer des abréviations</translation>
    </message>
    <message>
        <source>What Comes Out</source>
        <translation>Résultat</translation>
    </message>
    <message numerus="yes">
        <source>%n more</source>
        <translation>
            <numerusform>%n de plus</numerusform>
            <numerusform>%n de plus</numerusform>
        </translation>
    </message>
    <message>
        <source>Included by %1</source>
        <translation>Inclus par %1</translation>
    </message>
</context>
<context>
    <name>plume::ProgramAdder</name>
    <message>
        <source>Add</source>
        <translation>Ajouter</translation>
    </message>
    <message>
        <source>Add a program</source>
        <translation>Ajouter un programme</translation>
    </message>
    <message>
        <source>&amp;Running Program…</source>
        <translation>Programme en &amp;cours…</translation>
    </message>
    <message>
        <source>&amp;Installed Program…</source>
        <translation>Programme &amp;installé…</translation>
    </message>
    <message>
        <source>&amp;Point at a Window…</source>
        <translation>&amp;Désigner une fenêtre…</translation>
    </message>
    <message>
        <source>&amp;Type an Identifier…</source>
        <translation>&amp;Saisir un identifiant…</translation>
    </message>
    <message>
        <source>Running Programs</source>
        <translation>Programmes en cours</translation>
    </message>
    <message>
        <source>Installed Programs</source>
        <translation>Programmes installés</translation>
    </message>
    <message>
        <source>Click in a window of the program within 20 seconds.</source>
        <translation>Cliquez dans une fenêtre du programme d’ici 20 secondes.</translation>
    </message>
    <message>
        <source>No window of another program was clicked.</source>
        <translation>Aucune fenêtre d’un autre programme n’a été cliquée.</translation>
    </message>
    <message>
        <source>Add a Program</source>
        <translation>Ajouter un programme</translation>
    </message>
    <message>
        <source>Identifier of the program: the name of its desktop file without “.desktop”, or its window class</source>
        <translation>Identifiant du programme&#x202f;: le nom de son fichier desktop sans «&#x202f;.desktop&#x202f;», ou sa classe de fenêtre</translation>
    </message>
    <message>
        <source>&amp;Add Program</source>
        <translation>&amp;Ajouter le programme</translation>
    </message>
    <message>
        <source>&amp;Cancel</source>
        <translation>A&amp;nnuler</translation>
    </message>
</context>
<context>
    <name>plume::ProgramChooser</name>
    <message>
        <source>No programs are there to choose from.</source>
        <translation>Il n’y a aucun programme à choisir.</translation>
    </message>
    <message>
        <source>Program</source>
        <translation>Programme</translation>
    </message>
    <message>
        <source>Identifier</source>
        <translation>Identifiant</translation>
    </message>
    <message>
        <source>Filter</source>
        <translation>Filtrer</translation>
    </message>
    <message>
        <source>Programs</source>
        <translation>Programmes</translation>
    </message>
    <message>
        <source>&amp;Add Program</source>
        <translation>&amp;Ajouter le programme</translation>
    </message>
    <message>
        <source>&amp;Cancel</source>
        <translation>A&amp;nnuler</translation>
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
        <translation>Plume ne peut pas encore développer les abréviations</translation>
    </message>
    <message>
        <source>Put this right, then choose “Check Again”. You can also continue and do it later: until then Plume runs, but abbreviations may stay as you type them.</source>
        <translation>Réglez cela, puis choisissez «&#x202f;Vérifier à nouveau&#x202f;». Vous pouvez aussi continuer et le faire plus tard&#x202f;: d’ici là Plume fonctionne, mais les abréviations restent peut-être telles que vous les tapez.</translation>
    </message>
    <message>
        <source>Check &amp;Again</source>
        <translation>&amp;Vérifier à nouveau</translation>
    </message>
    <message>
        <source>&amp;Continue Anyway</source>
        <translation>&amp;Continuer quand même</translation>
    </message>
    <message>
        <source>What is missing</source>
        <translation>Ce qui manque</translation>
    </message>
    <message>
        <source>Looked again at %1: it is not right yet. You can also continue and put it right later.</source>
        <translation>Vérifié à nouveau à %1&#x202f;: ce n’est pas encore réglé. Vous pouvez aussi continuer et régler cela plus tard.</translation>
    </message>
    <message>
        <source>Plume is ready</source>
        <translation>Plume est prêt</translation>
    </message>
    <message>
        <source>All that was missing is there now.</source>
        <translation>Tout ce qui manquait est là maintenant.</translation>
    </message>
    <message>
        <source>&amp;Close</source>
        <translation>&amp;Fermer</translation>
    </message>
</context>
<context>
    <name>plume::QuickSearchModel</name>
    <message>
        <source>Similar</source>
        <translation>Approchants</translation>
    </message>
</context>
<context>
    <name>plume::QuickSearchWindow</name>
    <message>
        <source>Quick Search</source>
        <translation>Recherche rapide</translation>
    </message>
    <message>
        <source>Return inserts, Ctrl+Return copies, Ctrl+E edits, Esc closes</source>
        <translation>Entrée insère, Ctrl+Entrée copie, Ctrl+E modifie, Échap ferme</translation>
    </message>
    <message>
        <source>Search snippets</source>
        <translation>Rechercher des extraits</translation>
    </message>
    <message>
        <source>Found snippets</source>
        <translation>Extraits trouvés</translation>
    </message>
    <message>
        <source>Search in</source>
        <translation>Chercher dans</translation>
    </message>
    <message>
        <source>What is searched</source>
        <translation>Ce qui est parcouru</translation>
    </message>
    <message>
        <source>&amp;Abbreviations</source>
        <translation>Les &amp;abréviations</translation>
    </message>
    <message>
        <source>&amp;Contents</source>
        <translation>Les &amp;contenus</translation>
    </message>
    <message>
        <source>&amp;Labels</source>
        <translation>Les &amp;libellés</translation>
    </message>
    <message>
        <source>&amp;Wildcards</source>
        <translation>Les &amp;jokers</translation>
    </message>
    <message>
        <source>You have no snippets yet.</source>
        <translation>Vous n’avez pas encore d’extraits.</translation>
    </message>
    <message>
        <source>Nothing was found.</source>
        <translation>Rien n’a été trouvé.</translation>
    </message>
</context>
<context>
    <name>plume::ReportsWindow</name>
    <message numerus="yes">
        <source>%1 (%n times)</source>
        <translation>
            <numerusform>%1 (%n fois)</numerusform>
            <numerusform>%1 (%n fois)</numerusform>
        </translation>
    </message>
    <message>
        <source>Recent Reports</source>
        <translation>Rapports récents</translation>
    </message>
    <message>
        <source>Plume has had nothing to report.</source>
        <translation>Plume n’a rien eu à signaler.</translation>
    </message>
    <message>
        <source>Time</source>
        <translation>Heure</translation>
    </message>
    <message>
        <source>Report</source>
        <translation>Rapport</translation>
    </message>
    <message>
        <source>What you can do</source>
        <translation>Ce que vous pouvez faire</translation>
    </message>
    <message>
        <source>Reports, newest first</source>
        <translation>Rapports, le plus récent d’abord</translation>
    </message>
    <message>
        <source>&amp;Copy All</source>
        <translation>&amp;Tout copier</translation>
    </message>
    <message>
        <source>C&amp;lear</source>
        <translation>&amp;Effacer</translation>
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
        <translation>Restaurer</translation>
    </message>
    <message>
        <source>&amp;Restore Backup</source>
        <translation>&amp;Restaurer la sauvegarde</translation>
    </message>
    <message>
        <source>Backups, newest first</source>
        <translation>Sauvegardes, la plus récente d’abord</translation>
    </message>
    <message>
        <source>&amp;Backups of your snippets:</source>
        <translation>&amp;Sauvegardes de vos extraits&#x202f;:</translation>
    </message>
    <message>
        <source>Choose &amp;File…</source>
        <translation>Choisir un &amp;fichier…</translation>
    </message>
    <message>
        <source>Your snippets can be put back to what they were when a backup was made. What you have now is saved first.</source>
        <translation>Vos extraits peuvent redevenir ce qu’ils étaient lors d’une sauvegarde. Ce que vous avez maintenant est d’abord sauvegardé.</translation>
    </message>
    <message>
        <source>There is no backup in %1 yet.</source>
        <translation>Il n’y a pas encore de sauvegarde dans %1.</translation>
    </message>
    <message>
        <source>Select a .plume file to restore</source>
        <translation>Choisir un fichier .plume à restaurer</translation>
    </message>
    <message>
        <source>Plume libraries (*.plume)</source>
        <translation>Bibliothèques de Plume (*.plume)</translation>
    </message>
    <message>
        <source>Your 1 snippet is replaced by what this backup holds:</source>
        <translation>Votre unique extrait est remplacé par le contenu de cette sauvegarde&#x202f;:</translation>
    </message>
    <message numerus="yes">
        <source>Your %n snippets are replaced by what this backup holds:</source>
        <translation>
            <numerusform>Votre %n extrait est remplacé par le contenu de cette sauvegarde&#x202f;:</numerusform>
            <numerusform>Vos %n extraits sont remplacés par le contenu de cette sauvegarde&#x202f;:</numerusform>
        </translation>
    </message>
    <message>
        <source>Do you want to restore this backup?</source>
        <translation>Voulez-vous restaurer cette sauvegarde&#x202f;?</translation>
    </message>
    <message>
        <source>Plume writes a backup of what you have now first.</source>
        <translation>Plume sauvegarde d’abord ce que vous avez maintenant.</translation>
    </message>
    <message>
        <source>Replace My Snippets</source>
        <translation>Remplacer mes extraits</translation>
    </message>
    <message>
        <source>Error when restoring backup</source>
        <translation>La sauvegarde n’a pas été restaurée</translation>
    </message>
    <message>
        <source>Your snippets were restored</source>
        <translation>Vos extraits ont été restaurés</translation>
    </message>
    <message>
        <source>What you had before is in this backup: %1</source>
        <translation>Ce que vous aviez avant est dans cette sauvegarde&#x202f;: %1</translation>
    </message>
    <message>
        <source>The selected backup file does not exist.</source>
        <translation>Le fichier de sauvegarde choisi n’existe pas.</translation>
    </message>
</context>
<context>
    <name>plume::ScriptEdit</name>
    <message>
        <source>Script</source>
        <translation>Script</translation>
    </message>
    <message>
        <source>Tab writes a tab. To leave the script with the keyboard, press Ctrl+Tab, or Escape and then Tab.</source>
        <translation>Tab insère une tabulation. Pour quitter le script au clavier, appuyez sur Ctrl+Tab, ou sur Échap puis Tab.</translation>
    </message>
</context>
<context>
    <name>plume::ScriptMark</name>
    <message>
        <source>Script: %1</source>
        <translation>Script&#x202f;: %1</translation>
    </message>
    <message>
        <source>What this script prints comes here.</source>
        <translation>Ce que ce script affiche vient ici.</translation>
    </message>
</context>
<context>
    <name>plume::ScriptRunPanel</name>
    <message>
        <source>Run &amp;Now</source>
        <translation>Exécuter &amp;maintenant</translation>
    </message>
    <message>
        <source>Cance&amp;l</source>
        <translation>Annule&amp;r</translation>
    </message>
    <message>
        <source>Output of the script</source>
        <translation>Sortie du script</translation>
    </message>
    <message>
        <source>What the script writes is shown here. Nothing is typed anywhere.</source>
        <translation>Ce que le script écrit s’affiche ici. Rien n’est tapé nulle part.</translation>
    </message>
    <message>
        <source>Starting…</source>
        <translation>Démarrage…</translation>
    </message>
    <message>
        <source>The script&apos;s placeholders cannot be replaced.</source>
        <translation>Les balises du script ne peuvent pas être remplacées.</translation>
    </message>
    <message>
        <source>Cancelled.</source>
        <translation>Annulé.</translation>
    </message>
    <message>
        <source>Cancelling…</source>
        <translation>Annulation…</translation>
    </message>
    <message>
        <source>Running for %1 of at most %2 seconds.</source>
        <translation>En cours depuis %1 sur %2 secondes au plus.</translation>
    </message>
    <message>
        <source>AppleScript cannot run on this system.</source>
        <translation>AppleScript ne peut pas fonctionner sur ce système.</translation>
    </message>
    <message>
        <source>A script is ended after %1 seconds.</source>
        <translation>Un script est arrêté après %1 secondes.</translation>
    </message>
    <message>
        <source>Errors:</source>
        <translation>Erreurs&#x202f;:</translation>
    </message>
    <message>
        <source>The script says that it failed, after %1 seconds.</source>
        <translation>Le script signale un échec, après %1 secondes.</translation>
    </message>
    <message>
        <source>Finished after %1 seconds.</source>
        <translation>Terminé après %1 secondes.</translation>
    </message>
    <message>
        <source>Ended at the time limit of %1 seconds.</source>
        <translation>Arrêté à la limite de %1 secondes.</translation>
    </message>
    <message>
        <source>Ended after %1 seconds, because it wrote too much.</source>
        <translation>Arrêté après %1 secondes, parce qu’il écrivait trop.</translation>
    </message>
    <message>
        <source>Cancelled after %1 seconds.</source>
        <translation>Annulé après %1 secondes.</translation>
    </message>
    <message>
        <source>The script could not be run: %1.</source>
        <translation>Le script n’a pas pu être lancé&#x202f;: %1.</translation>
    </message>
    <message>
        <source>A script that it includes was ended at the time limit.</source>
        <translation>Un script qu’il inclut a été arrêté à la limite de temps.</translation>
    </message>
    <message>
        <source>A script that it includes wrote too much.</source>
        <translation>Un script qu’il inclut écrivait trop.</translation>
    </message>
    <message>
        <source>A script that it includes could not be run.</source>
        <translation>Un script qu’il inclut n’a pas pu être lancé.</translation>
    </message>
    <message>
        <source>Fields had the values that they begin with.</source>
        <translation>Les champs avaient leurs valeurs initiales.</translation>
    </message>
    <message>
        <source>The script wrote nothing.</source>
        <translation>Le script n’a rien écrit.</translation>
    </message>
    <message>
        <source>As there is no other output, the errors are typed when the snippet expands.</source>
        <translation>Faute d’autre sortie, les erreurs sont tapées quand l’extrait est développé.</translation>
    </message>
    <message>
        <source>The output is no UTF-8 text: nothing is typed when the snippet expands.</source>
        <translation>La sortie n’est pas du texte UTF-8&#x202f;: rien n’est tapé quand l’extrait est développé.</translation>
    </message>
    <message>
        <source>The output is cut here: %1 more characters are not shown.</source>
        <translation>La sortie est coupée ici&#x202f;: %1 caractères de plus ne sont pas montrés.</translation>
    </message>
</context>
<context>
    <name>plume::SettingsModel</name>
    <message>
        <source>Setting</source>
        <translation>Réglage</translation>
    </message>
    <message>
        <source>Value</source>
        <translation>Valeur</translation>
    </message>
    <message>
        <source>Default</source>
        <translation>Par défaut</translation>
    </message>
</context>
<context>
    <name>plume::SnippetEditor</name>
    <message>
        <source>Plain text</source>
        <translation>Texte brut</translation>
    </message>
    <message>
        <source>Formatted text</source>
        <translation>Texte mis en forme</translation>
    </message>
    <message>
        <source>AppleScript</source>
        <translation>AppleScript</translation>
    </message>
    <message>
        <source>Shell script</source>
        <translation>Script shell</translation>
    </message>
    <message>
        <source>N&amp;ote:</source>
        <translation>&amp;Note&#x202f;:</translation>
    </message>
    <message>
        <source>Optional: a name for lists</source>
        <translation>Facultatif&#x202f;: un nom pour les listes</translation>
    </message>
    <message>
        <source>Optional: for yourself</source>
        <translation>Facultatif&#x202f;: pour vous-même</translation>
    </message>
    <message>
        <source>About the abbreviation</source>
        <translation>Au sujet de l’abréviation</translation>
    </message>
    <message>
        <source>&amp;Abbreviation:</source>
        <translation>&amp;Abréviation&#x202f;:</translation>
    </message>
    <message>
        <source>La&amp;bel:</source>
        <translation>&amp;Libellé&#x202f;:</translation>
    </message>
    <message>
        <source>&amp;Kind:</source>
        <translation>T&amp;ype&#x202f;:</translation>
    </message>
    <message>
        <source>&amp;Case:</source>
        <translation>&amp;Casse&#x202f;:</translation>
    </message>
    <message>
        <source>Without an abbreviation it can only be chosen from lists.</source>
        <translation>Sans abréviation, seules les listes y mènent.</translation>
    </message>
    <message>
        <source>⚠ “%1” in “%2” has this abbreviation, too.</source>
        <translation>⚠ «&#x202f;%1&#x202f;» dans «&#x202f;%2&#x202f;» a aussi cette abréviation.</translation>
    </message>
    <message>
        <source>⚠ “%1” in “%2” expands before this is typed.</source>
        <translation>⚠ «&#x202f;%1&#x202f;» dans «&#x202f;%2&#x202f;» se développe avant la fin de la frappe.</translation>
    </message>
    <message>
        <source>Created %1</source>
        <translation>Créé le %1</translation>
    </message>
    <message>
        <source>Changed %1</source>
        <translation>Modifié le %1</translation>
    </message>
    <message>
        <source>Used last %1</source>
        <translation>Utilisé le %1</translation>
    </message>
    <message>
        <source>Not used yet</source>
        <translation>Pas encore utilisé</translation>
    </message>
</context>
<context>
    <name>plume::SnippetForm</name>
    <message>
        <source>Snippet</source>
        <translation>Extrait</translation>
    </message>
    <message>
        <source>Abbreviation, label or text</source>
        <translation>Abréviation, libellé ou texte</translation>
    </message>
    <message>
        <source>&amp;Search:</source>
        <translation>&amp;Rechercher&#x202f;:</translation>
    </message>
    <message>
        <source>Snip&amp;pet:</source>
        <translation>E&amp;xtrait&#x202f;:</translation>
    </message>
    <message>
        <source>Snippets</source>
        <translation>Extraits</translation>
    </message>
    <message>
        <source>Choose a snippet.</source>
        <translation>Choisissez un extrait.</translation>
    </message>
    <message>
        <source>Gives: nothing</source>
        <translation>Donne&#x202f;: rien</translation>
    </message>
    <message>
        <source>The library has no snippet with this abbreviation.</source>
        <translation>La bibliothèque n’a pas d’extrait avec cette abréviation.</translation>
    </message>
    <message>
        <source>A snippet cannot stand in itself.</source>
        <translation>Un extrait ne peut pas se contenir lui-même.</translation>
    </message>
    <message>
        <source>Runs the script and gives what it prints.</source>
        <translation>Exécute le script et donne ce qu’il affiche.</translation>
    </message>
    <message>
        <source>Gives: %1</source>
        <translation>Donne&#x202f;: %1</translation>
    </message>
</context>
<context>
    <name>plume::SnippetPreview</name>
    <message>
        <source>Preview of the selected snippet</source>
        <translation>Aperçu de l’extrait sélectionné</translation>
    </message>
    <message>
        <source>A script: what it prints is inserted.</source>
        <translation>Un script&#x202f;: ce qu’il affiche est inséré.</translation>
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
        <translation>Groupe sans nom</translation>
    </message>
    <message>
        <source>&amp;Quit Plume</source>
        <translation>&amp;Quitter Plume</translation>
    </message>
    <message>
        <source>&amp;Enabled</source>
        <translation>&amp;Activé</translation>
    </message>
    <message>
        <source>&amp;Listen to the Keyboard Again</source>
        <translation>&amp;Réécouter le clavier</translation>
    </message>
    <message>
        <source>&amp;New Snippet…</source>
        <translation>&amp;Nouvel extrait…</translation>
    </message>
    <message>
        <source>New Snippet from &amp;Clipboard…</source>
        <translation>Nouvel extrait du &amp;presse-papiers…</translation>
    </message>
    <message>
        <source>New Snippet from &amp;Selection…</source>
        <translation>Nouvel extrait de la &amp;sélection…</translation>
    </message>
    <message>
        <source>Searc&amp;h Snippets…</source>
        <translation>Rec&amp;hercher des extraits…</translation>
    </message>
    <message>
        <source>E&amp;dit Snippets…</source>
        <translation>&amp;Modifier les extraits…</translation>
    </message>
    <message>
        <source>&amp;Preferences…</source>
        <translation>Pré&amp;férences…</translation>
    </message>
    <message>
        <source>Help and &amp;Tools</source>
        <translation>Aide et &amp;outils</translation>
    </message>
    <message>
        <source>&amp;Why Didn&apos;t It Expand?</source>
        <translation>&amp;Pourquoi ne s’est-il rien passé&#x202f;?</translation>
    </message>
    <message>
        <source>&amp;Reports</source>
        <translation>&amp;Rapports</translation>
    </message>
    <message>
        <source>&amp;Diagnostics…</source>
        <translation>&amp;Diagnostic…</translation>
    </message>
    <message>
        <source>W&amp;elcome…</source>
        <translation>&amp;Bienvenue…</translation>
    </message>
    <message>
        <source>&amp;About Plume</source>
        <translation>À propos de P&amp;lume</translation>
    </message>
    <message>
        <source>Li&amp;brary</source>
        <translation>&amp;Bibliothèque</translation>
    </message>
    <message>
        <source>&amp;Import…</source>
        <translation>&amp;Importer…</translation>
    </message>
    <message>
        <source>&amp;Export…</source>
        <translation>&amp;Exporter…</translation>
    </message>
    <message>
        <source>&amp;Restore…</source>
        <translation>&amp;Restaurer…</translation>
    </message>
</context>
<context>
    <name>plume::SuggestionWindow</name>
    <message>
        <source>Suggestions</source>
        <translation>Suggestions</translation>
    </message>
    <message>
        <source>Suggested snippets</source>
        <translation>Extraits suggérés</translation>
    </message>
    <message>
        <source>%1 to %2 of %3</source>
        <translation>%1 à %2 sur %3</translation>
    </message>
</context>
<context>
    <name>plume::TimeForm</name>
    <message>
        <source>Time</source>
        <translation>Heure</translation>
    </message>
    <message>
        <source>Added:</source>
        <translation>Ajout&#x202f;:</translation>
    </message>
    <message>
        <source>Hours:</source>
        <translation>Heures&#x202f;:</translation>
    </message>
    <message>
        <source>Hours added</source>
        <translation>Heures ajoutées</translation>
    </message>
    <message>
        <source>Minutes:</source>
        <translation>Minutes&#x202f;:</translation>
    </message>
    <message>
        <source>Minutes added</source>
        <translation>Minutes ajoutées</translation>
    </message>
    <message>
        <source>Seconds:</source>
        <translation>Secondes&#x202f;:</translation>
    </message>
    <message>
        <source>Seconds added</source>
        <translation>Secondes ajoutées</translation>
    </message>
</context>
<context>
    <name>plume::TrayIcon</name>
    <message>
        <source>Plume: off</source>
        <translation>Plume&#x202f;: désactivé</translation>
    </message>
    <message>
        <source>Plume: does not hear the keyboard</source>
        <translation>Plume&#x202f;: n’entend pas le clavier</translation>
    </message>
    <message>
        <source>Plume: on</source>
        <translation>Plume&#x202f;: activé</translation>
    </message>
</context>
<context>
    <name>plume::UnsentTextWindow</name>
    <message>
        <source>&amp;Copy</source>
        <translation>&amp;Copier</translation>
    </message>
    <message>
        <source>Text Not Inserted</source>
        <translation>Texte non inséré</translation>
    </message>
    <message>
        <source>The text was not inserted</source>
        <translation>Le texte n’a pas été inséré</translation>
    </message>
    <message>
        <source>Plume keeps it until you close this window.</source>
        <translation>Plume le garde jusqu’à ce que vous fermiez cette fenêtre.</translation>
    </message>
    <message>
        <source>The text</source>
        <translation>Le texte</translation>
    </message>
    <message>
        <source>&amp;Try Again</source>
        <translation>&amp;Réessayer</translation>
    </message>
    <message>
        <source>&amp;Discard</source>
        <translation>&amp;Abandonner</translation>
    </message>
    <message>
        <source>Copied. The text is in the clipboard now.</source>
        <translation>Copié. Le texte est maintenant dans le presse-papiers.</translation>
    </message>
    <message>
        <source>Discard the text? Press Esc or close the window once more to discard it.</source>
        <translation>Abandonner le texte&#x202f;? Appuyez de nouveau sur Échap ou fermez de nouveau la fenêtre pour l’abandonner.</translation>
    </message>
</context>
<context>
    <name>plume::WelcomeWindow</name>
    <message>
        <source>Welcome to Plume</source>
        <translation>Bienvenue dans Plume</translation>
    </message>
    <message>
        <source>&amp;Get Started</source>
        <translation>&amp;C’est parti</translation>
    </message>
    <message>
        <source>Plume keeps texts that you write often as snippets, each with a short abbreviation. Type the abbreviation in any program, and Plume puts the text in its place. Your snippets stay on this computer.</source>
        <translation>Plume garde les textes que vous écrivez souvent sous forme d’extraits, chacun avec une courte abréviation. Tapez l’abréviation dans n’importe quel programme, et Plume met le texte à sa place. Vos extraits restent sur cet ordinateur.</translation>
    </message>
    <message>
        <source>Try it</source>
        <translation>Essayez</translation>
    </message>
    <message>
        <source>&amp;Type here:</source>
        <translation>&amp;Tapez ici&#x202f;:</translation>
    </message>
    <message>
        <source>Not tried yet</source>
        <translation>Pas encore essayé</translation>
    </message>
    <message>
        <source>becomes “%1”</source>
        <translation>devient «&#x202f;%1&#x202f;»</translation>
    </message>
    <message>
        <source>Done</source>
        <translation>Fait</translation>
    </message>
    <message>
        <source>That is all there is to it.</source>
        <translation>C’est tout.</translation>
    </message>
    <message>
        <source>Bring your snippets along</source>
        <translation>Apportez vos extraits</translation>
    </message>
    <message>
        <source>Snippets of other programs were found. Importing leaves them as they are.</source>
        <translation>Des extraits d’autres programmes ont été trouvés. L’import les laisse tels quels.</translation>
    </message>
    <message>
        <source>Import</source>
        <translation>Importer</translation>
    </message>
    <message>
        <source>Import %1</source>
        <translation>Importer %1</translation>
    </message>
    <message>
        <source>Imported</source>
        <translation>Importé</translation>
    </message>
    <message>
        <source>&amp;Start Plume when I log in</source>
        <translation>Lancer Plume à l’&amp;ouverture de session</translation>
    </message>
    <message>
        <source>Your desktop has no place for Plume’s icon. To reach Plume, run “plume” again, or use its hot keys.</source>
        <translation>Votre bureau n’a pas de place pour l’icône de Plume. Pour accéder à Plume, relancez «&#x202f;plume&#x202f;», ou utilisez ses raccourcis clavier.</translation>
    </message>
    <message>
        <source>This could not be changed</source>
        <translation>Cela n’a pas pu être changé</translation>
    </message>
    <message>
        <source>and a space become “%1”</source>
        <extracomment>What stands before it is an abbreviation; %1 is its text.</extracomment>
        <translation>et une espace deviennent «&#x202f;%1&#x202f;»</translation>
    </message>
</context>
</TS>
