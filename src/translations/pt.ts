<?xml version="1.0" encoding="utf-8"?>
<!DOCTYPE TS>
<TS version="2.1" language="pt">
<context>
    <name>main</name>
    <message>
        <source>KAVOR Networks Updater</source>
        <translation>Atualizadores das Redes KAVOR</translation>
    </message>
    <message>
        <source>Checking software updates...
Please wait.
</source>
        <translation>A procurar atualizações de software...
Aguarde.
</translation>
    </message>
    <message>
        <source>Installing software updates...
Please wait.
</source>
        <translation>A instalar as atualizações de software...
Aguarde.
</translation>
    </message>
    <message>
        <source>Closing updater application...
Please wait.
</source>
        <translation>A fechar a aplicação do atualizador...
Aguarde.
</translation>
    </message>
    <message>
        <source>YES</source>
        <translation>SIM</translation>
    </message>
    <message>
        <source>NO</source>
        <translation>NÃO</translation>
    </message>
    <message>
        <source>CLOSE</source>
        <translation>FECHAR</translation>
    </message>
    <message>
        <source>No updates found.</source>
        <translation>Nenhuma atualização encontrada. </translation>
    </message>
    <message>
        <source>Software update successfully installed.</source>
        <translation>Atualização do software instalada com sucesso.</translation>
    </message>
    <message>
        <source>Checking for updates failed. Please make sure USB drive has been prepared properly.</source>
        <translation>A verificação de atualizações falhou. Verifique se a porta USB está adequadamente preparada.</translation>
    </message>
    <message>
        <source>Installing of update failed. Please try again later.</source>
        <translation>A instalação da atualização falhou. Tente novamente mais tarde.</translation>
    </message>
</context>
</TS>
