<?xml version="1.0" encoding="utf-8"?>
<!DOCTYPE TS>
<TS version="2.1">
<context>
    <name>main</name>
    <message>
        <source>KAVOR Networks Updater</source>
        <translation>KAVOR 网络更新程序</translation>
    </message>
    <message>
        <source>Checking software updates...
Please wait.
</source>
        <translation>正在检查软件更新...
请稍候。
</translation>
    </message>
    <message>
        <source>Installing software updates...
Please wait.
</source>
        <translation>正在安装软件更新...
请稍候。
</translation>
    </message>
    <message>
        <source>Closing updater application...
Please wait.
</source>
        <translation>正在关闭更新程序应用程序...
请稍候。
</translation>
    </message>
    <message>
        <source>YES</source>
        <translation>是</translation>
    </message>
    <message>
        <source>NO</source>
        <translation>否</translation>
    </message>
    <message>
        <source>CLOSE</source>
        <translation>关闭</translation>
    </message>
    <message>
        <source>No updates found.</source>
        <translation>未找到更新。</translation>
    </message>
    <message>
        <source>Software update successfully installed.</source>
        <translation>软件更新已成功安装。</translation>
    </message>
    <message>
        <source>Checking for updates failed. Please make sure USB drive has been prepared properly.</source>
        <translation>检查更新失败。请确保已正确准备 USB 驱动器。</translation>
    </message>
    <message>
        <source>Installing of update failed. Please try again later.</source>
        <translation>安装更新失败。请稍后再试。</translation>
    </message>
</context>
</TS>
