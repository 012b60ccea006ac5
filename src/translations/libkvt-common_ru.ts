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
    <name>MiscModel</name>
    <message>
        <source>Data</source>
        <translation>Данные</translation>
    </message>
</context>
<context>
    <name>Process</name>
    <message>
        <source>Process &apos;%1&apos; not finished</source>
        <translation>Процесс '%1' не завершён</translation>
    </message>
    <message>
        <source>Process &apos;%1&apos; execute with error code &apos;%2&apos;</source>
        <translation>Процесс '%1' завершился с кодом ошибки '%2'</translation>
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
    <message>
        <source>&quot;%1&quot; not exists</source>
        <translation>"%1" не существует</translation>
    </message>
    <message>
        <source>&quot;%1&quot; error %2
%3</source>
        <translation>"%1" ошибка %2
%3</translation>
    </message>
    <message>
        <source>Process: &quot;%1 %2&quot;. Error: %3.
&quot;Not started&quot;</source>
        <translation>Процесс: "%1 %2". Ошибка: %3.
"Не запущен"</translation>
    </message>
    <message>
        <source>Process: &quot;%1 %2&quot;. Error: %3.
&quot;Not finished&quot;</source>
        <translation>Процесс: "%1 %2". Ошибка: %3.
"Не завершён"</translation>
    </message>
    <message>
        <source>Process: &quot;%1 %2&quot;. Exit code: %3.
&quot;%4&quot;</source>
        <translation>Процесс: "%1 %2". Код завершения: %3.
"%4"</translation>
    </message>
</context>
</TS>
