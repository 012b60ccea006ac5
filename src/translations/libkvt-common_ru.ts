<?xml version="1.0" encoding="utf-8"?>
<!DOCTYPE TS>
<TS version="2.1" language="ru_RU">
<context>
    <name>AbstractChoiceDialog</name>
    <message>
        <source>Choice</source>
        <translation>Выбор</translation>
    </message>
    <message>
        <source>Filter</source>
        <translation>Фильтр</translation>
    </message>
    <message>
        <source>Pattern type</source>
        <translation>Тип шаблона</translation>
    </message>
    <message>
        <source>Wildcard</source>
        <translation>Шаблон с подстановкой</translation>
    </message>
    <message>
        <source>RegExp</source>
        <comment>Regular expression</comment>
        <translation>Регулярное выражение</translation>
    </message>
    <message>
        <source>Fixed string</source>
        <comment>Fixed String</comment>
        <translation>Фиксированная строка</translation>
    </message>
    <message>
        <source>Pattern</source>
        <translation>Шаблон</translation>
    </message>
    <message>
        <source>All</source>
        <translation>Все</translation>
    </message>
</context>
<context>
    <name>ChoiceWidget</name>
    <message>
        <source>Add</source>
        <translation>Добавить</translation>
    </message>
    <message>
        <source>Remove</source>
        <translation>Удалить</translation>
    </message>
</context>
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
    <name>ControlServiceTask</name>
    <message>
        <source>Failed to execute command &quot;%1 %2&quot;</source>
        <translation>Не удалось выполнить команду &quot;%1 %2&quot;</translation>
    </message>
</context>
<context>
    <name>DummyTask</name>
    <message>
        <source>Dummy task</source>
        <translation>Пробная задача</translation>
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
    <name>ElementsElementWidget</name>
    <message>
        <source>Pattern type</source>
        <translation>Тип шаблона</translation>
    </message>
    <message>
        <source>Wildcard</source>
        <translation>Шаблон с подстановкой</translation>
    </message>
    <message>
        <source>RegExp</source>
        <comment>Regular expression</comment>
        <translation>Регулярное выражение</translation>
    </message>
    <message>
        <source>Fixed string</source>
        <comment>Fixed String</comment>
        <translation>Фиксированная строка</translation>
    </message>
    <message>
        <source>Pattern</source>
        <translation>Шаблон</translation>
    </message>
    <message>
        <source>Filter</source>
        <translation>Фильтр</translation>
    </message>
</context>
<context>
    <name>ExportHtmlTask</name>
    <message>
        <source>Export to HTML</source>
        <translation>Экспорт в HTML</translation>
    </message>
    <message>
        <source>&quot;%1&quot; error %2
%3</source>
        <translation>&quot;%1&quot; ошибка %2
%3</translation>
    </message>
</context>
<context>
    <name>ExportWidgetTask</name>
    <message>
        <source>Export</source>
        <translation>Экспорт</translation>
    </message>
    <message>
        <source>Export success!</source>
        <translation>Экспорт выполнен успешно!</translation>
    </message>
</context>
<context>
    <name>GecosDialog</name>
    <message>
        <source>GECOS</source>
        <translation>GECOS</translation>
    </message>
    <message>
        <source>Full name:</source>
        <translation>Полное имя:</translation>
    </message>
    <message>
        <source>Room number:</source>
        <translation>Номер комнаты:</translation>
    </message>
    <message>
        <source>Telephone:</source>
        <translation>Телефон:</translation>
    </message>
    <message>
        <source>Other:</source>
        <translation>Прочее:</translation>
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
    <name>PasswordDialog</name>
    <message>
        <source>Enter login and password</source>
        <translation>Введите имя пользователя и пароль</translation>
    </message>
    <message>
        <source>Login:</source>
        <translation>Имя пользователя:</translation>
    </message>
    <message>
        <source>Password:</source>
        <translation>Пароль:</translation>
    </message>
</context>
<context>
    <name>PasswordInputDialog</name>
    <message>
        <source>Change password</source>
        <translation>Смена пароля</translation>
    </message>
    <message>
        <source>Password:</source>
        <translation>Пароль:</translation>
    </message>
    <message>
        <source>Repeat:</source>
        <translation>Повтор:</translation>
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
    <name>PluginContainer</name>
    <message>
        <source>Plugin directory &apos;%1&apos; not exist.</source>
        <translation>Каталог модулей расширения «%1» не существует.</translation>
    </message>
    <message>
        <source>The plugin has no root object.</source>
        <translation>У модуля расширения нет корневого объекта.</translation>
    </message>
    <message>
        <source>The plugin does not implement the interface %1.</source>
        <translation>Модуль расширения не реализует интерфейс %1.</translation>
    </message>
    <message>
        <source>The plugin cannot work on this system.</source>
        <translation>Модуль расширения не может работать в этой системе.</translation>
    </message>
</context>
<context>
    <name>PluginDialog</name>
    <message>
        <source>Plugins and modules</source>
        <translation>Модули расширения и модули</translation>
    </message>
    <message>
        <source>Plugin path:</source>
        <translation>Путь к модулям расширения:</translation>
    </message>
    <message>
        <source>Change</source>
        <translation>Изменить</translation>
    </message>
    <message>
        <source>Plugins</source>
        <translation>Модули расширения</translation>
    </message>
    <message>
        <source>Modules</source>
        <translation>Модули</translation>
    </message>
    <message>
        <source>Plugin directory</source>
        <translation>Каталог модулей расширения</translation>
    </message>
</context>
<context>
    <name>PluginModel</name>
    <message>
        <source>Name</source>
        <translation>Имя</translation>
    </message>
    <message>
        <source>Description</source>
        <translation>Описание</translation>
    </message>
</context>
<context>
    <name>PreviewDialog</name>
    <message>
        <source>Print preview</source>
        <translation>Предварительный просмотр</translation>
    </message>
    <message>
        <source>Export</source>
        <translation>Экспорт</translation>
    </message>
    <message>
        <source>Print</source>
        <translation>Печать</translation>
    </message>
    <message>
        <source>Export preview to HTML</source>
        <translation>Экспорт просмотра в HTML</translation>
    </message>
    <message>
        <source>HTML (*.html)</source>
        <translation>HTML (*.html)</translation>
    </message>
</context>
<context>
    <name>PrintWidgetTask</name>
    <message>
        <source>Internal error: %1</source>
        <translation>Внутренняя ошибка: %1</translation>
    </message>
    <message>
        <source>XML transformation failed</source>
        <translation>Ошибка преобразования XML</translation>
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
        <source>started</source>
        <translation>запущен</translation>
    </message>
    <message>
        <source>stopped</source>
        <translation>остановлен</translation>
    </message>
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
<context>
    <name>ServiceTask</name>
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
<context>
    <name>StoppableDummyTask</name>
    <message>
        <source>Stoppable dummy task</source>
        <translation>Останавливаемая пробная задача</translation>
    </message>
    <message>
        <source>Terminate by user</source>
        <translation>Прервано пользователем</translation>
    </message>
</context>
<context>
    <name>TaskObserver</name>
    <message>
        <source>The task was not started: no worker thread is free.</source>
        <translation>Задача не запущена: нет свободного рабочего потока.</translation>
    </message>
    <message>
        <source>The task finished without reporting its outcome.</source>
        <translation>Задача завершилась, не сообщив о результате.</translation>
    </message>
    <message>
        <source>The task was dropped without running: the worker threads were stopped.</source>
        <translation>Задача снята без запуска: рабочие потоки остановлены.</translation>
    </message>
</context>
<context>
    <name>TaskObserverDialog</name>
    <message>
        <source>Tasks</source>
        <translation>Задачи</translation>
    </message>
    <message>
        <source>More</source>
        <translation>Подробнее</translation>
    </message>
    <message>
        <source>Stop task</source>
        <translation>Остановить задачу</translation>
    </message>
    <message>
        <source>Stop</source>
        <translation>Остановить</translation>
    </message>
    <message>
        <source>Error</source>
        <translation>Ошибка</translation>
    </message>
    <message>
        <source>Warning</source>
        <translation>Предупреждение</translation>
    </message>
    <message>
        <source>%1: %2</source>
        <translation>%1: %2</translation>
    </message>
</context>
<context>
    <name>TaskObserverModel</name>
    <message>
        <source>Task</source>
        <translation>Задача</translation>
    </message>
    <message>
        <source>Status</source>
        <translation>Состояние</translation>
    </message>
    <message>
        <source>Message</source>
        <translation>Сообщение</translation>
    </message>
    <message>
        <source>processing</source>
        <translation>выполняется</translation>
    </message>
    <message>
        <source>fail</source>
        <translation>ошибка</translation>
    </message>
    <message>
        <source>success</source>
        <translation>успешно</translation>
    </message>
    <message>
        <source>warning</source>
        <translation>предупреждение</translation>
    </message>
    <message>
        <source>about to be stop</source>
        <translation>останавливается</translation>
    </message>
</context>
<context>
    <name>ViewEditElementWidget</name>
    <message>
        <source>Element activation</source>
        <translation>Активация элемента</translation>
    </message>
    <message>
        <source>Changes not saved!
Continue without saving?</source>
        <translation>Изменения не сохранены!
Продолжить без сохранения?</translation>
    </message>
    <message>
        <source>Activation of this element not supported!</source>
        <translation>Активация этого элемента не поддерживается!</translation>
    </message>
</context>
</TS>
