<?xml version="1.0" encoding="utf-8"?>
<!DOCTYPE TS>
<TS version="2.1" language="de_DE">
<context>
    <name>Messages</name>
    <message>
        <source>A TAB character was found in the Part Description and will be deleted</source>
        <translation>In der Teilbeschreibung steht ein Tabulatorzeichen; es wird gelöscht</translation>
    </message>
    <message>
        <source>Save anyway and overwrite those changes?</source>
        <translation>Trotzdem speichern und diese Änderungen überschreiben?</translation>
    </message>
    <message>
        <source>Length of the part description is limited to 64 characters!</source>
        <translation>Die Teilbeschreibung darf höchstens 64 Zeichen lang sein!</translation>
    </message>
    <message>
        <source>You need to mention the Author!</source>
        <translation>Bitte den Autor angeben!</translation>
    </message>
    <message>
        <source>You need to set the BFC type!</source>
        <translation>Bitte die BFC-Anweisung wählen!</translation>
    </message>
    <message>
        <source>You need to set the License type!</source>
        <translation>Bitte die Lizenz wählen!</translation>
    </message>
    <message>
        <source>You need to set the Part type!</source>
        <translation>Bitte den Teiltyp wählen!</translation>
    </message>
    <message>
        <source>Parts with &apos;needs work&apos; in title needs a proper comment!</source>
        <translation>Teile mit „needs work“ in der Beschreibung brauchen einen passenden Kommentar!</translation>
    </message>
    <message>
        <source>Should this be corrected?</source>
        <translation>Soll das korrigiert werden?</translation>
    </message>
    <message>
        <source>Should the &quot;0 ROTATION&quot; entries being deleted?</source>
        <translation>Sollen die Einträge „0 ROTATION“ gelöscht werden?</translation>
    </message>
    <message>
        <source>ROTATION in file</source>
        <translation>ROTATION in der Datei</translation>
    </message>
    <message>
        <source>Should the &quot;0 WRITE&quot; entries being deleted?</source>
        <translation>Sollen die Einträge „0 WRITE“ gelöscht werden?</translation>
    </message>
    <message>
        <source>Should the COLOR Entry be deleted?</source>
        <translation>Soll der COLOR-Eintrag gelöscht werden?</translation>
    </message>
    <message>
        <source>COLOR Entry</source>
        <translation>COLOR-Eintrag</translation>
    </message>
    <message>
        <source>Saving the file is not possible</source>
        <translation>Die Datei kann nicht gespeichert werden</translation>
    </message>
    <message>
        <source>You have not set your username. Do you want to save anyway?</source>
        <translation>Du hast keinen Benutzernamen angegeben. Trotzdem speichern?</translation>
    </message>
    <message>
        <source>Delete Entry</source>
        <translation>Eintrag löschen</translation>
    </message>
    <message>
        <source>The entry &apos;&lt;none&gt;&apos; is not allowed to delete.</source>
        <translation>Der Eintrag „&lt;none&gt;“ kann nicht gelöscht werden.</translation>
    </message>
    <message>
        <source>Update Entry</source>
        <translation>Eintrag ändern</translation>
    </message>
    <message>
        <source>The entry &apos;&lt;none&gt;&apos; is not allowed to change.</source>
        <translation>Der Eintrag „&lt;none&gt;“ kann nicht geändert werden.</translation>
    </message>
    <message>
        <source>Do you want to save the changes to the list?</source>
        <translation>Sollen die Änderungen an der Liste gespeichert werden?</translation>
    </message>
    <message>
        <source>Changed Categories</source>
        <translation>Geänderte Liste</translation>
    </message>
    <message>
        <source>Please enter the new category</source>
        <translation>Bitte die neue Kategorie eingeben</translation>
    </message>
    <message>
        <source>New Category</source>
        <translation>Neue Kategorie</translation>
    </message>
    <message>
        <source>Please enter the new part type</source>
        <translation>Bitte den neuen Teiltyp eingeben</translation>
    </message>
    <message>
        <source>New Part Type</source>
        <translation>Neuer Teiltyp</translation>
    </message>
    <message>
        <source>Please enter the new BFC Statement</source>
        <translation>Bitte die neue BFC-Anweisung eingeben</translation>
    </message>
    <message>
        <source>New BFC Statement</source>
        <translation>Neue BFC-Anweisung</translation>
    </message>
    <message>
        <source>Please enter the new license type</source>
        <translation>Bitte die neue Lizenz eingeben</translation>
    </message>
    <message>
        <source>New License Type</source>
        <translation>Neue Lizenz</translation>
    </message>
    <message>
        <source>Do you want to save the changes to the file?</source>
        <translation>Sollen die Änderungen an der Datei gespeichert werden?</translation>
    </message>
    <message>
        <source>File Changed</source>
        <translation>Datei geändert</translation>
    </message>
    <message>
        <source>The current file has been changed. Do you want to save the changes?</source>
        <translation>Die aktuelle Datei wurde geändert. Sollen die Änderungen gespeichert werden?</translation>
    </message>
    <message>
        <source>Current File has changed</source>
        <translation>Aktuelle Datei geändert</translation>
    </message>
    <message>
        <source>To change the category can result in an non LDraw conform part. Please change the category only if there is an official statement from LSC.</source>
        <translation>Wer die Kategorie ändert, kann ein Teil erzeugen, das nicht dem LDraw-Standard entspricht. Bitte die Kategorie nur ändern, wenn das LSC es offiziell festgelegt hat.</translation>
    </message>
    <message>
        <source>Do you want to proceed?</source>
        <translation>Fortfahren?</translation>
    </message>
    <message>
        <source>Category Change</source>
        <translation>Kategorie ändern</translation>
    </message>
    <message>
        <source>Your preferences hold no name yet, so the names in this file stay as they are. Enter yours in Option › Preferences.</source>
        <translation>In den Einstellungen steht noch kein Name, daher bleiben die Namen in dieser Datei, wie sie sind. Trage deinen unter Optionen › Einstellungen ein.</translation>
    </message>
    <message>
        <source>Are you sure to substitute the existing Real Name, Username and License Type with your values set in the preferences?</source>
        <translation>Sollen Name, Benutzername und Lizenz der Datei wirklich durch die Werte aus den Einstellungen ersetzt werden?</translation>
    </message>
    <message>
        <source>Default Values</source>
        <translation>Standardwerte</translation>
    </message>
    <message>
        <source>File Changed on Disk</source>
        <translation>Datei auf der Festplatte geändert</translation>
    </message>
    <message>
        <source>File Locked</source>
        <translation>Datei gesperrt</translation>
    </message>
    <message>
        <source>Interrupted</source>
        <translation>Abgebrochen</translation>
    </message>
    <message>
        <source>Interrupted Save</source>
        <translation>Abgebrochenes Speichern</translation>
    </message>
    <message>
        <source>Missing Username</source>
        <translation>Benutzername fehlt</translation>
    </message>
    <message>
        <source>Please enter !History string in the following format:</source>
        <translation>Bitte die !HISTORY-Zeile in dieser Form eingeben:</translation>
    </message>
    <message>
        <source>&apos;YYYY-MM-DD [Username] what&apos;s new/changed&apos;</source>
        <translation>„JJJJ-MM-TT [Benutzername] was neu ist/sich geändert hat“</translation>
    </message>
    <message>
        <source>This file is written in ISO-8859-1, which cannot hold a character you typed.</source>
        <translation>Diese Datei ist in ISO-8859-1 geschrieben, das ein eingegebenes Zeichen nicht darstellen kann.</translation>
    </message>
    <message>
        <source>The text was not changed.</source>
        <translation>Der Text wurde nicht geändert.</translation>
    </message>
    <message>
        <source>Please enter your Keyword with comma separated.</source>
        <translation>Bitte die Schlüsselwörter durch Kommas getrennt eingeben.</translation>
    </message>
    <message>
        <source>Keywords</source>
        <translation>Schlüsselwörter</translation>
    </message>
    <message>
        <source>Please change your Keywords like you wish.</source>
        <translation>Bitte die Schlüsselwörter nach Wunsch ändern.</translation>
    </message>
    <message>
        <source>Please enter your Comment</source>
        <translation>Bitte den Kommentar eingeben</translation>
    </message>
    <message>
        <source>Comment</source>
        <translation>Kommentar</translation>
    </message>
    <message>
        <source>Please enter Comments</source>
        <translation>Bitte die Kommentare eingeben</translation>
    </message>
    <message>
        <source>Comments</source>
        <translation>Kommentare</translation>
    </message>
    <message>
        <source>History</source>
        <translation>Historie</translation>
    </message>
    <message>
        <source>Load DAT-File</source>
        <translation>DAT-Datei laden</translation>
    </message>
    <message>
        <source>LDraw DAT-File (*.dat)</source>
        <translation>LDraw-DAT-Datei (*.dat)</translation>
    </message>
</context>
<context>
    <name>WindowProgress</name>
    <message>
        <source>Parsing file. Line %1. Please wait...</source>
        <translation>Datei wird gelesen. Zeile %1. Bitte warten …</translation>
    </message>
</context>
<context>
    <name>frmHelp</name>
    <message>
        <source>Quillmark Help</source>
        <translation>Quillmark-Hilfe</translation>
    </message>
    <message>
        <source>C&amp;lose</source>
        <translation>Sch&amp;ließen</translation>
    </message>
</context>
<context>
    <name>frmList</name>
    <message>
        <source> Category</source>
        <translation> Kategorien</translation>
    </message>
    <message>
        <source> Part Types</source>
        <translation> Teiltypen</translation>
    </message>
    <message>
        <source> BFC</source>
        <translation> BFC</translation>
    </message>
    <message>
        <source> License Types</source>
        <translation> Lizenzen</translation>
    </message>
    <message>
        <source>List</source>
        <translation>Liste</translation>
    </message>
    <message>
        <source>Current Values</source>
        <translation>Aktuelle Einträge</translation>
    </message>
    <message>
        <source>Update</source>
        <translation>Ändern</translation>
    </message>
    <message>
        <source>Add</source>
        <translation>Hinzufügen</translation>
    </message>
    <message>
        <source>Close</source>
        <translation>Schließen</translation>
    </message>
    <message>
        <source>Delete</source>
        <translation>Löschen</translation>
    </message>
</context>
<context>
    <name>frmMain</name>
    <message>
        <source>Part Description:</source>
        <translation>Teilbeschreibung:</translation>
    </message>
    <message>
        <source>Length:</source>
        <translation>Länge:</translation>
    </message>
    <message>
        <source>File Name:</source>
        <translation>Dateiname:</translation>
    </message>
    <message>
        <source>Author:</source>
        <translation>Autor:</translation>
    </message>
    <message>
        <source>Real Name</source>
        <translation>Name</translation>
    </message>
    <message>
        <source>Username:</source>
        <translation>Benutzer:</translation>
    </message>
    <message>
        <source>Part Type:</source>
        <translation>Teiltyp:</translation>
    </message>
    <message>
        <source>License Type:</source>
        <translation>Lizenz:</translation>
    </message>
    <message>
        <source>Set Preferences</source>
        <translation>Vorgaben</translation>
    </message>
    <message>
        <source>BFC Statement</source>
        <translation>BFC-Anweisung</translation>
    </message>
    <message>
        <source>Category</source>
        <translation>Kategorie</translation>
    </message>
    <message>
        <source>Keywords</source>
        <translation>Schlüsselwörter</translation>
    </message>
    <message>
        <source>Edit</source>
        <translation>Ändern</translation>
    </message>
    <message>
        <source>Add</source>
        <translation>Neu</translation>
    </message>
    <message>
        <source>Delete</source>
        <translation>Löschen</translation>
    </message>
    <message>
        <source>Comments</source>
        <translation>Kommentare</translation>
    </message>
    <message>
        <source>History</source>
        <translation>Historie</translation>
    </message>
    <message>
        <source>New Header:</source>
        <translation>Neuer Header:</translation>
    </message>
    <message>
        <source>Old Header:</source>
        <translation>Alter Header:</translation>
    </message>
    <message>
        <source>F&amp;ile</source>
        <translation>&amp;Datei</translation>
    </message>
    <message>
        <source>&amp;Edit</source>
        <translation>&amp;Bearbeiten</translation>
    </message>
    <message>
        <source>&amp;Option</source>
        <translation>&amp;Optionen</translation>
    </message>
    <message>
        <source>O&amp;pen</source>
        <translation>Ö&amp;ffnen</translation>
    </message>
    <message>
        <source>&amp;Save</source>
        <translation>&amp;Speichern</translation>
    </message>
    <message>
        <source>Check for the Parts &amp;Tracker</source>
        <translation>Für den Parts &amp;Tracker prüfen</translation>
    </message>
    <message>
        <source>E&amp;xit</source>
        <translation>&amp;Beenden</translation>
    </message>
    <message>
        <source>&amp;Category</source>
        <translation>&amp;Kategorien</translation>
    </message>
    <message>
        <source>&amp;Part Types</source>
        <translation>&amp;Teiltypen</translation>
    </message>
    <message>
        <source>&amp;BFC Statements</source>
        <translation>&amp;BFC-Anweisungen</translation>
    </message>
    <message>
        <source>&amp;License Types</source>
        <translation>&amp;Lizenzen</translation>
    </message>
    <message>
        <source>Preferences</source>
        <translation>Einstellungen</translation>
    </message>
    <message>
        <source>Welcome to the Quillmark program.</source>
        <translation>Willkommen bei Quillmark.</translation>
    </message>
    <message>
        <source>Length: %1</source>
        <translation>Länge: %1</translation>
    </message>
    <message>
        <source>Parsing file. Please wait...</source>
        <translation>Datei wird gelesen. Bitte warten …</translation>
    </message>
    <message>
        <source>Saved %1</source>
        <translation>%1 gespeichert</translation>
    </message>
    <message>
        <source>Saved %1 (backup %2)</source>
        <translation>%1 gespeichert (Sicherung %2)</translation>
    </message>
    <message>
        <source>%1 errors</source>
        <translation>%1 Fehler</translation>
    </message>
    <message>
        <source>%1 warnings</source>
        <translation>%1 Warnungen</translation>
    </message>
    <message>
        <source>Quillmark Version: %1</source>
        <translation>Quillmark Version: %1</translation>
    </message>
    <message>
        <source>Copyright %1 %2</source>
        <translation>Copyright %1 %2</translation>
    </message>
    <message>
        <source>&amp;Help</source>
        <translation>&amp;Hilfe</translation>
    </message>
    <message>
        <source>Save &amp;As…</source>
        <translation>Speichern &amp;unter…</translation>
    </message>
    <message>
        <source>&amp;Contents</source>
        <translation>&amp;Inhalt</translation>
    </message>
    <message>
        <source>&amp;About Quillmark</source>
        <translation>Ü&amp;ber Quillmark</translation>
    </message>
    <message>
        <source> [read-only]</source>
        <translation> [schreibgeschützt]</translation>
    </message>
    <message>
        <source>Read-only (%1): Save As (%2) keeps your changes.</source>
        <translation>Schreibgeschützt (%1): Speichern unter (%2) behält deine Änderungen.</translation>
    </message>
    <message>
        <source>%1 in Option › Preferences</source>
        <translation>%1 unter Optionen › Einstellungen</translation>
    </message>
    <message>
        <source>Checks: not made (%1)</source>
        <translation>Prüfungen: nicht gemacht (%1)</translation>
    </message>
    <message>
        <source>Checks: nothing found</source>
        <translation>Prüfungen: nichts gefunden</translation>
    </message>
    <message>
        <source>1 error</source>
        <translation>1 Fehler</translation>
    </message>
    <message>
        <source>1 warning</source>
        <translation>1 Warnung</translation>
    </message>
    <message>
        <source>Checks: %1 (%2)</source>
        <translation>Prüfungen: %1 (%2)</translation>
    </message>
</context>
<context>
    <name>frmOption</name>
    <message>
        <source>Preferences</source>
        <translation>Einstellungen</translation>
    </message>
    <message>
        <source>&amp;Save</source>
        <translation>&amp;Speichern</translation>
    </message>
    <message>
        <source>&amp;Cancel</source>
        <translation>&amp;Abbrechen</translation>
    </message>
    <message>
        <source>Your names go into the Author line of the parts you save and into new History lines.</source>
        <translation>Deine Namen kommen in die Autorzeile der Teile, die du speicherst, und in neue Historienzeilen.</translation>
    </message>
    <message>
        <source>Limit Part Description to 64 characters</source>
        <translation>Teilbeschreibung auf 64 Zeichen begrenzen</translation>
    </message>
    <message>
        <source>Your &amp;Real Name</source>
        <translation>Dein &amp;Name</translation>
    </message>
    <message>
        <source>Your &amp;Username</source>
        <translation>Dein &amp;Benutzername</translation>
    </message>
    <message>
        <source>&amp;License Type:</source>
        <translation>&amp;Lizenz:</translation>
    </message>
    <message>
        <source>&amp;Backup file</source>
        <translation>Sicherungs&amp;kopie</translation>
    </message>
</context>
<context>
    <name>frmTracker</name>
    <message>
        <source>The Parts Tracker would accept this file, with the warnings below.</source>
        <translation>Der Parts Tracker würde diese Datei annehmen, mit den Warnungen unten.</translation>
    </message>
    <message>
        <source>Check for the Parts Tracker</source>
        <translation>Für den Parts Tracker prüfen</translation>
    </message>
    <message>
        <source>Level</source>
        <translation>Stufe</translation>
    </message>
    <message>
        <source>Id</source>
        <translation>Kennung</translation>
    </message>
    <message>
        <source>Line</source>
        <translation>Zeile</translation>
    </message>
    <message>
        <source>Fix</source>
        <translation>Beheben</translation>
    </message>
    <message>
        <source>Message</source>
        <translation>Meldung</translation>
    </message>
    <message>
        <source>error</source>
        <translation>Fehler</translation>
    </message>
    <message>
        <source>warning</source>
        <translation>Warnung</translation>
    </message>
    <message>
        <source>line %1: </source>
        <translation>Zeile %1: </translation>
    </message>
    <message>
        <source>yes</source>
        <translation>ja</translation>
    </message>
    <message>
        <source>This part can be saved, and the Parts Tracker&apos;s rules find nothing.</source>
        <translation>Dieses Teil kann gespeichert werden, und die Regeln des Parts Trackers finden nichts.</translation>
    </message>
    <message>
        <source>Save refuses this part: %1.</source>
        <translation>Speichern lehnt dieses Teil ab: %1.</translation>
    </message>
    <message>
        <source>1 error</source>
        <translation>1 Fehler</translation>
    </message>
    <message>
        <source>%1 errors</source>
        <translation>%1 Fehler</translation>
    </message>
    <message>
        <source>The Parts Tracker would refuse this file: %1.</source>
        <translation>Der Parts Tracker würde diese Datei ablehnen: %1.</translation>
    </message>
    <message>
        <source>The Parts Tracker&apos;s rules find nothing.</source>
        <translation>Die Regeln des Parts Trackers finden nichts.</translation>
    </message>
    <message>
        <source>Nothing to fix: no row has a repair that can be made here.</source>
        <translation>Nichts zu beheben: Keine Zeile hat eine Reparatur, die hier möglich ist.</translation>
    </message>
    <message>
        <source>&amp;Copy</source>
        <translation>&amp;Kopieren</translation>
    </message>
    <message>
        <source>C&amp;lose</source>
        <translation>Sch&amp;ließen</translation>
    </message>
    <message>
        <source>&amp;Fix</source>
        <translation>&amp;Beheben</translation>
    </message>
    <message>
        <source>Fix &amp;All</source>
        <translation>&amp;Alle beheben</translation>
    </message>
</context>
<context>
    <name>std</name>
    <message>
        <source>Enter your real name: it goes into the Author line of the parts you save.</source>
        <translation>Gib deinen Namen ein: Er kommt in die Author-Zeile der Teile, die du speicherst.</translation>
    </message>
    <message>
        <source>Enter your username: it goes into the Author line and into new History lines.</source>
        <translation>Gib deinen Benutzernamen ein: Er kommt in die Author-Zeile und in neue History-Zeilen.</translation>
    </message>
</context>
</TS>
