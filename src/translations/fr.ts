<?xml version="1.0" encoding="utf-8"?>
<!DOCTYPE TS>
<TS version="2.1" language="fr">
<context>
    <name>main</name>
    <message>
        <source>KAVOR Networks Updater</source>
        <translation>Mise à jour KAVOR Networks</translation>
    </message>
    <message>
        <source>Checking software updates...
Please wait.
</source>
        <translation>Recherche de mises à jour logicielles…
Veuillez patienter.
</translation>
    </message>
    <message>
        <source>Installing software updates...
Please wait.
</source>
        <translation>Installation des mises à jour logicielles...
Veuillez patienter.
</translation>
    </message>
    <message>
        <source>Closing updater application...
Please wait.
</source>
        <translation>Fermeture de l'application des mises à jour...
Veuillez patienter.
</translation>
    </message>
    <message>
        <source>YES</source>
        <translation>OUI</translation>
    </message>
    <message>
        <source>NO</source>
        <translation>NON</translation>
    </message>
    <message>
        <source>CLOSE</source>
        <translation>FERMER</translation>
    </message>
    <message>
        <source>No updates found.</source>
        <translation>Pas de mises à jour disponibles.</translation>
    </message>
    <message>
        <source>Software update successfully installed.</source>
        <translation>La mise à jour logicielle a été installée avec succès.</translation>
    </message>
    <message>
        <source>Checking for updates failed. Please make sure USB drive has been prepared properly.</source>
        <translation>La recherche des mises à jour a échoué. Veuillez vérifier que la clé USB a été correctement configurée.</translation>
    </message>
    <message>
        <source>Installing of update failed. Please try again later.</source>
        <translation>L'installation de la mise à jour a échoué. Veuillez réessayer ultérieurement.</translation>
    </message>
</context>
</TS>
