<?xml version="1.0" encoding="utf-8"?>
<!DOCTYPE TS>
<TS version="2.1" language="de">
<context>
    <name>main</name>
    <message>
        <source>KAVOR Networks Updater</source>
        <translation>KAVOR Networks Updater</translation>
    </message>
    <message>
        <source>Checking software updates...
Please wait.
</source>
        <translation>Prüfung auf Software-Updates...
Bitte warten.
</translation>
    </message>
    <message>
        <source>Installing software updates...
Please wait.
</source>
        <translation>Software-Updates werden installiert...
Bitte warten.
</translation>
    </message>
    <message>
        <source>Closing updater application...
Please wait.
</source>
        <translation>Der Updater wird geschlossen...
Bitte warten.
</translation>
    </message>
    <message>
        <source>YES</source>
        <translation>JA</translation>
    </message>
    <message>
        <source>NO</source>
        <translation>NEIN</translation>
    </message>
    <message>
        <source>CLOSE</source>
        <translation>SCHLIESSEN</translation>
    </message>
    <message>
        <source>No updates found.</source>
        <translation>Keine Updates gefunden.</translation>
    </message>
    <message>
        <source>Software update successfully installed.</source>
        <translation>Software-Update erfolgreich installiert.</translation>
    </message>
    <message>
        <source>Checking for updates failed. Please make sure USB drive has been prepared properly.</source>
        <translation>Fehler bei der Prüfung auf Updates. Bitte vergewissern Sie sich, dass das USB-Laufwerk korrekt vorbereitet wurde.</translation>
    </message>
    <message>
        <source>Installing of update failed. Please try again later.</source>
        <translation>Fehler bei der Installation des Updates. Bitte versuchen Sie es später erneut.</translation>
    </message>
</context>
</TS>
