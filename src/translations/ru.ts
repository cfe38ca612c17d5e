<?xml version="1.0" encoding="utf-8"?>
<!DOCTYPE TS>
<TS version="2.1" language="ru">
<context>
    <name>main</name>
    <message>
        <source>KAVOR Networks Updater</source>
        <translation>Программа установки обновлений KAVOR Networks</translation>
    </message>
    <message>
        <source>Checking software updates...
Please wait.
</source>
        <translation>Проверка обновлений ПО...
Пожалуйста, подождите.
</translation>
    </message>
    <message>
        <source>Installing software updates...
Please wait.
</source>
        <translation>Установка обновлений ПО...
Пожалуйста, подождите.
</translation>
    </message>
    <message>
        <source>Closing updater application...
Please wait.
</source>
        <translation>Завершение работы программы установки обновлений...
Пожалуйста, подождите.
</translation>
    </message>
    <message>
        <source>YES</source>
        <translation>ДА</translation>
    </message>
    <message>
        <source>NO</source>
        <translation>НЕТ</translation>
    </message>
    <message>
        <source>CLOSE</source>
        <translation>ЗАКРЫТЬ</translation>
    </message>
    <message>
        <source>No updates found.</source>
        <translation>Обновления не найдены.</translation>
    </message>
    <message>
        <source>Software update successfully installed.</source>
        <translation>Обновление программного обеспечения успешно установлено.</translation>
    </message>
    <message>
        <source>Checking for updates failed. Please make sure USB drive has been prepared properly.</source>
        <translation>Не удалось проверить наличие обновлений. Пожалуйста, убедитесь, что USB-накопитель подготовлен надлежащим образом.</translation>
    </message>
    <message>
        <source>Installing of update failed. Please try again later.</source>
        <translation>Не удалось установить обновление. Пожалуйста, повторите попытку позже.</translation>
    </message>
</context>
</TS>
