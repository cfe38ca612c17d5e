<?xml version="1.0" encoding="utf-8"?>
<!DOCTYPE TS>
<TS version="2.1" language="en">
<context>
    <name>main</name>
    <message>
        <source>CLOSE</source>
        <translation>CLOSE</translation>
    </message>
</context>
</TS>
