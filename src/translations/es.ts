<?xml version="1.0" encoding="utf-8"?>
<!DOCTYPE TS>
<TS version="2.1" language="es">
<context>
    <name>main</name>
    <message>
        <source>KAVOR Networks Updater</source>
        <translation>Actualizador de KAVOR Networks</translation>
    </message>
    <message>
        <source>Checking software updates...
Please wait.
</source>
        <translation>Comprobando actualizaciones de software...
Por favor, espere.
</translation>
    </message>
    <message>
        <source>Installing software updates...
Please wait.
</source>
        <translation>Instalando actualizaciones de software...
Por favor, espere.
</translation>
    </message>
    <message>
        <source>Closing updater application...
Please wait.
</source>
        <translation>Cerrando la aplicación de actualización...
Por favor, espere.</translation>
    </message>
    <message>
        <source>YES</source>
        <translation>SÍ</translation>
    </message>
    <message>
        <source>NO</source>
        <translation>NO</translation>
    </message>
    <message>
        <source>CLOSE</source>
        <translation>CERRAR</translation>
    </message>
    <message>
        <source>No updates found.</source>
        <translation>No se han encontrado actualizaciones.</translation>
    </message>
    <message>
        <source>Software update successfully installed.</source>
        <translation>La actualización del software se ha instalado correctamente.</translation>
    </message>
    <message>
        <source>Checking for updates failed. Please make sure USB drive has been prepared properly.</source>
        <translation>La búsqueda de actualizaciones ha fallado. Asegúrese de que la unidad USB ha sido preparada correctamente.</translation>
    </message>
    <message>
        <source>Installing of update failed. Please try again later.</source>
        <translation>Error en la instalación de la actualización. Por favor, inténtelo de nuevo más tarde.</translation>
    </message>
</context>
</TS>
