<?xml version="1.0" encoding="utf-8"?>
<!DOCTYPE TS>
<TS version="2.1" language="ru_RU">
<context>
    <name>ConfRootTreeNode</name>
    <message>
        <source>Name</source>
        <translation>Имя</translation>
    </message>
    <message>
        <source>Value</source>
        <translation>Значение</translation>
    </message>
</context>
<context>
    <name>Element</name>
    <message>
        <source>Do you really want to remove this element?</source>
        <translation>Вы действительно хотите удалить этот элемент?</translation>
    </message>
</context>
<context>
    <name>ElementRootTreeNode</name>
    <message>
        <source>Name</source>
        <translation>Имя</translation>
    </message>
</context>
<context>
    <name>Module</name>
    <message>
        <source>Force reread mode</source>
        <translation>Режим принудительного перечитывания</translation>
    </message>
</context>
<context>
    <name>ModuleRootTreeNode</name>
    <message>
        <source>Name</source>
        <translation>Имя</translation>
    </message>
    <message>
        <source>Reread</source>
        <translation>Перечитывать</translation>
    </message>
    <message>
        <source>Description</source>
        <translation>Описание</translation>
    </message>
</context>
<context>
    <name>QObject</name>
    <message>
        <source>started</source>
        <translation>запущен</translation>
    </message>
    <message>
        <source>stopped</source>
        <translation>остановлен</translation>
    </message>
</context>
</TS>
