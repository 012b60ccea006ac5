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
    <name>PgsqlCluster</name>
    <message>
        <source>Cluster info not valid &apos;%1&apos;</source>
        <translation>Неверные сведения о кластере &apos;%1&apos;</translation>
    </message>
    <message>
        <source>SQL request &apos;%1&apos; contains a character that cannot be passed to the shell</source>
        <translation>SQL-запрос &apos;%1&apos; содержит символ, который нельзя передать командной оболочке</translation>
    </message>
    <message>
        <source>SQL request &apos;%1&apos; not mathed</source>
        <translation>SQL-запрос &apos;%1&apos; не сопоставлен</translation>
    </message>
    <message>
        <source>User name &apos;%1&apos; is not a plain SQL identifier</source>
        <translation>Имя пользователя &apos;%1&apos; не является простым идентификатором SQL</translation>
    </message>
</context>
<context>
    <name>Process</name>
    <message>
        <source>Process &apos;%1&apos; not finished</source>
        <translation>Процесс &apos;%1&apos; не завершён</translation>
    </message>
    <message>
        <source>Process &apos;%1&apos; execute with error code &apos;%2&apos;</source>
        <translation>Процесс &apos;%1&apos; завершился с кодом ошибки &apos;%2&apos;</translation>
    </message>
</context>
<context>
    <name>QObject</name>
    <message>
        <source>&quot;%1&quot; not exists</source>
        <translation>&quot;%1&quot; не существует</translation>
    </message>
    <message>
        <source>&quot;%1&quot; error %2
%3</source>
        <translation>&quot;%1&quot; ошибка %2
%3</translation>
    </message>
    <message>
        <source>Process: &quot;%1 %2&quot;. Error: %3.
&quot;Not started&quot;</source>
        <translation>Процесс: &quot;%1 %2&quot;. Ошибка: %3.
&quot;Не запущен&quot;</translation>
    </message>
    <message>
        <source>Process: &quot;%1 %2&quot;. Error: %3.
&quot;Not finished&quot;</source>
        <translation>Процесс: &quot;%1 %2&quot;. Ошибка: %3.
&quot;Не завершён&quot;</translation>
    </message>
    <message>
        <source>Process: &quot;%1 %2&quot;. Exit code: %3.
&quot;%4&quot;</source>
        <translation>Процесс: &quot;%1 %2&quot;. Код завершения: %3.
&quot;%4&quot;</translation>
    </message>
</context>
</TS>
