<?xml version="1.0" encoding="utf-8"?>
<!-- SPDX-FileCopyrightText: 2026 The libkvt-common developers -->
<!-- SPDX-License-Identifier: LGPL-2.1-or-later -->
<!DOCTYPE TS>
<TS version="2.1" language="ru_RU">
<context>
    <name>AdminOptions</name>
    <message>
        <source>Administers this computer through plugins.</source>
        <translation>Администрирование компьютера через модули.</translation>
    </message>
    <message>
        <source>Loads the plugins below &lt;dir&gt; (may be given more than once). Default: %1, and the folders of KVT_ADMIN_PLUGIN_PATH.</source>
        <translation>Загрузить модули из папки &lt;dir&gt; (можно указать несколько раз). По умолчанию: %1 и папки из KVT_ADMIN_PLUGIN_PATH.</translation>
    </message>
    <message>
        <source>dir</source>
        <translation>папка</translation>
    </message>
    <message>
        <source>Prints the plugin files tried, the module tree and the element tree once every container has been read (waiting at most %1 seconds), then exits.</source>
        <translation>Вывести проверенные файлы модулей, дерево модулей и дерево элементов после чтения всех контейнеров (ожидание не более %1 с) и завершиться.</translation>
    </message>
    <message>
        <source>Renders the main window after start-up to the PNG &lt;file&gt;, then exits.</source>
        <translation>Сохранить главное окно после запуска в PNG-файл &lt;file&gt; и завершиться.</translation>
    </message>
    <message>
        <source>file</source>
        <translation>файл</translation>
    </message>
    <message>
        <source>Lets plugins that change the system (services, accounts) make changes; without it they only show.</source>
        <translation>Разрешить модулям, изменяющим систему (службы, учётные записи), вносить изменения; без этого они только показывают.</translation>
    </message>
    <message>
        <source>Runs tasks on &lt;n&gt; worker threads (1 to %1, default 2).</source>
        <translation>Выполнять задачи в &lt;n&gt; рабочих потоках (от 1 до %1, по умолчанию 2).</translation>
    </message>
    <message>
        <source>n</source>
        <translation>n</translation>
    </message>
    <message>
        <source>--screenshot needs a file name.</source>
        <translation>Для --screenshot нужно имя файла.</translation>
    </message>
    <message>
        <source>--workers takes a number from 1 to %1, not &quot;%2&quot;.</source>
        <translation>--workers принимает число от 1 до %1, а не &quot;%2&quot;.</translation>
    </message>
</context>
<context>
    <name>ConfFileFormat</name>
    <message>
        <source>The key is empty.</source>
        <translation>Ключ пуст.</translation>
    </message>
    <message>
        <source>A key holds no blank, &quot;=&quot; or &quot;#&quot;.</source>
        <translation>Ключ не может содержать пробел, &quot;=&quot; или &quot;#&quot;.</translation>
    </message>
    <message>
        <source>A value cannot hold &quot;#&quot;: it would start a comment.</source>
        <translation>Значение не может содержать &quot;#&quot;: с него начинается комментарий.</translation>
    </message>
    <message>
        <source>A value is one line.</source>
        <translation>Значение занимает одну строку.</translation>
    </message>
    <message>
        <source>The value is longer than %1 characters.</source>
        <translation>Значение длиннее %1 символов.</translation>
    </message>
    <message>
        <source>A comment is one line.</source>
        <translation>Комментарий занимает одну строку.</translation>
    </message>
    <message>
        <source>&quot;%1&quot; error %2
%3</source>
        <translation>&quot;%1&quot; ошибка %2
%3</translation>
    </message>
    <message>
        <source>Line %1 is not valid text in this system&apos;s encoding; it is kept as it is and cannot be changed here.</source>
        <translation>Строка %1 не является текстом в кодировке системы; она сохраняется как есть и не может быть изменена здесь.</translation>
    </message>
    <message>
        <source>Line %1 is longer than %2 characters; it is kept as it is and cannot be changed here.</source>
        <translation>Строка %1 длиннее %2 символов; она сохраняется как есть и не может быть изменена здесь.</translation>
    </message>
    <message>
        <source>&quot;%1&quot; changed while it was read; read it again.</source>
        <translation>&quot;%1&quot; изменился во время чтения; прочитайте его снова.</translation>
    </message>
    <message>
        <source>&quot;%1&quot;: the key &quot;%2&quot; is set %3 times (lines %4); each line is shown and changed on its own.</source>
        <translation>&quot;%1&quot;: ключ &quot;%2&quot; задан %3 раз(а) (строки %4); каждая строка показывается и изменяется отдельно.</translation>
    </message>
</context>
<context>
    <name>ConfFilesModule</name>
    <message>
        <source>Key/value configuration files (none set: list them under &quot;%1&quot; in the settings)</source>
        <translation>Файлы настройки «ключ = значение» (не заданы: перечислите их в параметре &quot;%1&quot;)</translation>
    </message>
    <message>
        <source>Key/value configuration files: %1</source>
        <translation>Файлы настройки «ключ = значение»: %1</translation>
    </message>
</context>
<context>
    <name>ConfFilesPlugin</name>
    <message>
        <source>Configuration files</source>
        <translation>Файлы настройки</translation>
    </message>
    <message>
        <source>Reads and changes the keys of key/value configuration files</source>
        <translation>Чтение и изменение ключей в файлах настройки «ключ = значение»</translation>
    </message>
</context>
<context>
    <name>CreateKeyTask</name>
    <message>
        <source>Add &quot;%1&quot; to &quot;%2&quot;</source>
        <translation>Добавление &quot;%1&quot; в &quot;%2&quot;</translation>
    </message>
    <message>
        <source>&quot;%1&quot; already sets &quot;%2&quot; (line %3); nothing was added.</source>
        <translation>В &quot;%1&quot; уже задан &quot;%2&quot; (строка %3); ничего не добавлено.</translation>
    </message>
    <message>
        <source>&quot;%1&quot; was given &quot;%2&quot; meanwhile; nothing was added.</source>
        <translation>Тем временем в &quot;%1&quot; появился &quot;%2&quot;; ничего не добавлено.</translation>
    </message>
    <message>
        <source>&quot;%1&quot; added to &quot;%2&quot;.</source>
        <translation>&quot;%1&quot; добавлен в &quot;%2&quot;.</translation>
    </message>
</context>
<context>
    <name>DeleteKeyTask</name>
    <message>
        <source>Remove &quot;%1&quot; from &quot;%2&quot;</source>
        <translation>Удаление &quot;%1&quot; из &quot;%2&quot;</translation>
    </message>
    <message>
        <source>Line %1 of &quot;%2&quot; changed on disk while it was written; it was kept as it was. Read the file again.</source>
        <translation>Строка %1 файла &quot;%2&quot; изменилась на диске во время записи; она оставлена как была. Прочитайте файл снова.</translation>
    </message>
    <message>
        <source>Line %1 removed from &quot;%2&quot;.</source>
        <translation>Строка %1 удалена из &quot;%2&quot;.</translation>
    </message>
</context>
<context>
    <name>Inventory</name>
    <message>
        <source>on</source>
        <translation>вкл.</translation>
    </message>
    <message>
        <source>off</source>
        <translation>выкл.</translation>
    </message>
    <message>
        <source>Plugin files:</source>
        <translation>Файлы модулей:</translation>
    </message>
    <message>
        <source>(none)</source>
        <translation>(нет)</translation>
    </message>
    <message>
        <source>accepted</source>
        <translation>принят</translation>
    </message>
    <message>
        <source>refused</source>
        <translation>отклонён</translation>
    </message>
    <message>
        <source>Modules:</source>
        <translation>Модули:</translation>
    </message>
    <message>
        <source>Elements:</source>
        <translation>Элементы:</translation>
    </message>
    <message>
        <source>Problems:</source>
        <translation>Проблемы:</translation>
    </message>
    <message>
        <source>fail</source>
        <translation>ошибка</translation>
    </message>
    <message>
        <source>warning</source>
        <translation>предупреждение</translation>
    </message>
    <message>
        <source>kvt-admin: the elements were still being read after %1 seconds.</source>
        <translation>kvt-admin: элементы всё ещё читались через %1 с.</translation>
    </message>
</context>
<context>
    <name>KeyElement</name>
    <message>
        <source>Line %1: %2</source>
        <translation>Строка %1: %2</translation>
    </message>
</context>
<context>
    <name>KeyWidget</name>
    <message>
        <source>Key</source>
        <translation>Ключ</translation>
    </message>
    <message>
        <source>&amp;Key:</source>
        <translation>&amp;Ключ:</translation>
    </message>
    <message>
        <source>&amp;Value:</source>
        <translation>&amp;Значение:</translation>
    </message>
    <message>
        <source>&amp;Comment:</source>
        <translation>&amp;Комментарий:</translation>
    </message>
    <message>
        <source>Line:</source>
        <translation>Строка:</translation>
    </message>
    <message>
        <source>New key in %1</source>
        <translation>Новый ключ в %1</translation>
    </message>
    <message>
        <source>New key</source>
        <translation>Новый ключ</translation>
    </message>
    <message>
        <source>appended to %1</source>
        <translation>добавляется в конец %1</translation>
    </message>
    <message>
        <source>%1 of %2</source>
        <translation>%1 в %2</translation>
    </message>
</context>
<context>
    <name>MainWindow</name>
    <message>
        <source>System administration</source>
        <translation>Администрирование системы</translation>
    </message>
    <message>
        <source>&amp;Modules</source>
        <translation>&amp;Модули</translation>
    </message>
    <message>
        <source>&amp;Elements</source>
        <translation>&amp;Элементы</translation>
    </message>
    <message>
        <source>&amp;Create</source>
        <translation>&amp;Создать</translation>
    </message>
    <message>
        <source>Create a new element here</source>
        <translation>Создать здесь новый элемент</translation>
    </message>
    <message>
        <source>&amp;Delete</source>
        <translation>&amp;Удалить</translation>
    </message>
    <message>
        <source>Delete the current element</source>
        <translation>Удалить текущий элемент</translation>
    </message>
    <message>
        <source>&amp;Apply</source>
        <translation>&amp;Применить</translation>
    </message>
    <message>
        <source>Write the changes</source>
        <translation>Записать изменения</translation>
    </message>
    <message>
        <source>Ca&amp;ncel</source>
        <translation>&amp;Отменить</translation>
    </message>
    <message>
        <source>Forget the changes</source>
        <translation>Забыть изменения</translation>
    </message>
    <message>
        <source>&amp;Reread</source>
        <translation>П&amp;еречитать</translation>
    </message>
    <message>
        <source>Read the current element again from the system</source>
        <translation>Снова прочитать текущий элемент из системы</translation>
    </message>
    <message>
        <source>&amp;Plugins...</source>
        <translation>&amp;Модули расширения...</translation>
    </message>
    <message>
        <source>&amp;Tasks...</source>
        <translation>&amp;Задачи...</translation>
    </message>
    <message>
        <source>&amp;Quit</source>
        <translation>В&amp;ыход</translation>
    </message>
    <message>
        <source>&amp;File</source>
        <translation>&amp;Файл</translation>
    </message>
    <message>
        <source>&amp;Element</source>
        <translation>&amp;Элемент</translation>
    </message>
    <message>
        <source>Element</source>
        <translation>Элемент</translation>
    </message>
    <message>
        <source>No plugin folder: %1</source>
        <translation>Нет папки модулей: %1</translation>
    </message>
    <message>
        <source>%1 plugin files tried, %2 accepted, %3 modules</source>
        <translation>Проверено файлов модулей: %1, принято: %2, модулей: %3</translation>
    </message>
    <message>
        <source>Unsaved changes</source>
        <translation>Несохранённые изменения</translation>
    </message>
    <message>
        <source>The new element is not created yet.
Create it before leaving?</source>
        <translation>Новый элемент ещё не создан.
Создать его перед уходом?</translation>
    </message>
    <message>
        <source>The changes to &quot;%1&quot; are not applied.
Apply them before leaving?</source>
        <translation>Изменения в &quot;%1&quot; не применены.
Применить их перед уходом?</translation>
    </message>
    <message>
        <source>Nothing can be created here.</source>
        <translation>Здесь ничего нельзя создать.</translation>
    </message>
    <message>
        <source>Delete</source>
        <translation>Удаление</translation>
    </message>
</context>
<context>
    <name>QObject</name>
    <message>
        <source>kvt-admin: plugin folder &quot;%1&quot; does not exist</source>
        <translation>kvt-admin: папка модулей &quot;%1&quot; не существует</translation>
    </message>
    <message>
        <source>kvt-admin: window rendered to %1</source>
        <translation>kvt-admin: окно сохранено в %1</translation>
    </message>
    <message>
        <source>kvt-admin: cannot write %1</source>
        <translation>kvt-admin: не удаётся записать %1</translation>
    </message>
    <message>
        <source>Plugins</source>
        <translation>Модули</translation>
    </message>
    <message>
        <source>These plugin folders do not exist:
%1</source>
        <translation>Эти папки модулей не существуют:
%1</translation>
    </message>
    <message>
        <source>kvt-admin: tasks still running at exit; waiting for them to stop</source>
        <translation>kvt-admin: при выходе ещё выполняются задачи; ожидание их завершения</translation>
    </message>
</context>
<context>
    <name>ReadFileTask</name>
    <message>
        <source>Read &quot;%1&quot;</source>
        <translation>Чтение &quot;%1&quot;</translation>
    </message>
</context>
<context>
    <name>ReadKeyTask</name>
    <message>
        <source>Read &quot;%1&quot; in &quot;%2&quot;</source>
        <translation>Чтение &quot;%1&quot; в &quot;%2&quot;</translation>
    </message>
    <message>
        <source>&quot;%1&quot; no longer sets &quot;%2&quot;; read the file again.</source>
        <translation>В &quot;%1&quot; больше не задан &quot;%2&quot;; прочитайте файл снова.</translation>
    </message>
</context>
<context>
    <name>UpdateKeyTask</name>
    <message>
        <source>Change &quot;%1&quot; in &quot;%2&quot;</source>
        <translation>Изменение &quot;%1&quot; в &quot;%2&quot;</translation>
    </message>
    <message>
        <source>Line %1 of &quot;%2&quot; changed on disk while it was written; it was kept as it was. Read the file again.</source>
        <translation>Строка %1 файла &quot;%2&quot; изменилась на диске во время записи; она оставлена как была. Прочитайте файл снова.</translation>
    </message>
    <message>
        <source>Line %1 of &quot;%2&quot; written.</source>
        <translation>Строка %1 файла &quot;%2&quot; записана.</translation>
    </message>
</context>
</TS>
