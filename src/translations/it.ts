<?xml version="1.0" encoding="utf-8"?>
<!DOCTYPE TS>
<TS version="2.1" language="it">
<context>
    <name>main</name>
    <message>
        <source>KAVOR Networks Updater</source>
        <translation>Utility di aggiornamento KAVOR Networks</translation>
    </message>
    <message>
        <source>Checking software updates...
Please wait.
</source>
        <translation>Verifica disponibilità aggiornamenti software in corso...
Attendere.
</translation>
    </message>
    <message>
        <source>Installing software updates...
Please wait.
</source>
        <translation>Installazione aggiornamenti software in corso...
Attendere.
</translation>
    </message>
    <message>
        <source>Closing updater application...
Please wait.
</source>
        <translation>Chiusura utility di aggiornamento in corso...
Attendere.
</translation>
    </message>
    <message>
        <source>YES</source>
        <translation>SÌ</translation>
    </message>
    <message>
        <source>NO</source>
        <translation>NO</translation>
    </message>
    <message>
        <source>CLOSE</source>
        <translation>CHIUDI</translation>
    </message>
    <message>
        <source>No updates found.</source>
        <translation>Nessun aggiornamento disponibile trovato.</translation>
    </message>
    <message>
        <source>Software update successfully installed.</source>
        <translation>Aggiornamento software eseguito correttamente.</translation>
    </message>
    <message>
        <source>Checking for updates failed. Please make sure USB drive has been prepared properly.</source>
        <translation>Verifica disponibilità aggiornamenti non riuscita. Assicurarsi che l’unità USB sia stata preparata correttamente.</translation>
    </message>
    <message>
        <source>Installing of update failed. Please try again later.</source>
        <translation>Installazione aggiornamento non riuscita. Riprovare in seguito.</translation>
    </message>
</context>
</TS>
