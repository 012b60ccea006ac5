<?xml version="1.0" encoding="utf-8"?>
<!DOCTYPE TS>
<TS version="2.1" language="ru_RU">
<context>
    <name>AdminOptions</name>
    <message>
        <source>Administers this computer through plugins.</source>
        <translation type="unfinished"></translation>
    </message>
    <message>
        <source>Loads the plugins below &lt;dir&gt; (may be given more than once). Default: %1, and the folders of KVT_ADMIN_PLUGIN_PATH.</source>
        <translation type="unfinished"></translation>
    </message>
    <message>
        <source>dir</source>
        <translation type="unfinished"></translation>
    </message>
    <message>
        <source>Prints the plugin files tried, the module tree and the element tree once every container has been read (waiting at most %1 seconds), then exits.</source>
        <translation type="unfinished"></translation>
    </message>
    <message>
        <source>Renders the main window after start-up to the PNG &lt;file&gt;, then exits.</source>
        <translation type="unfinished"></translation>
    </message>
    <message>
        <source>file</source>
        <translation type="unfinished"></translation>
    </message>
    <message>
        <source>Lets plugins that change the system (services, accounts) make changes; without it they only show.</source>
        <translation type="unfinished"></translation>
    </message>
    <message>
        <source>Runs tasks on &lt;n&gt; worker threads (1 to %1, default 2).</source>
        <translation type="unfinished"></translation>
    </message>
    <message>
        <source>n</source>
        <translation type="unfinished"></translation>
    </message>
    <message>
        <source>--screenshot needs a file name.</source>
        <translation type="unfinished"></translation>
    </message>
    <message>
        <source>--workers takes a number from 1 to %1, not &quot;%2&quot;.</source>
        <translation type="unfinished"></translation>
    </message>
</context>
<context>
    <name>Inventory</name>
    <message>
        <source>on</source>
        <translation type="unfinished"></translation>
    </message>
    <message>
        <source>off</source>
        <translation type="unfinished"></translation>
    </message>
    <message>
        <source>Plugin files:</source>
        <translation type="unfinished"></translation>
    </message>
    <message>
        <source>(none)</source>
        <translation type="unfinished"></translation>
    </message>
    <message>
        <source>accepted</source>
        <translation type="unfinished"></translation>
    </message>
    <message>
        <source>refused</source>
        <translation type="unfinished"></translation>
    </message>
    <message>
        <source>Modules:</source>
        <translation type="unfinished"></translation>
    </message>
    <message>
        <source>Elements:</source>
        <translation type="unfinished"></translation>
    </message>
    <message>
        <source>Problems:</source>
        <translation type="unfinished"></translation>
    </message>
    <message>
        <source>fail</source>
        <translation type="unfinished"></translation>
    </message>
    <message>
        <source>warning</source>
        <translation type="unfinished"></translation>
    </message>
    <message>
        <source>kvt-admin: the elements were still being read after %1 seconds.</source>
        <translation type="unfinished"></translation>
    </message>
</context>
<context>
    <name>MainWindow</name>
    <message>
        <source>System administration</source>
        <translation type="unfinished"></translation>
    </message>
    <message>
        <source>&amp;Modules</source>
        <translation type="unfinished"></translation>
    </message>
    <message>
        <source>&amp;Elements</source>
        <translation type="unfinished"></translation>
    </message>
    <message>
        <source>&amp;Create</source>
        <translation type="unfinished"></translation>
    </message>
    <message>
        <source>Create a new element here</source>
        <translation type="unfinished"></translation>
    </message>
    <message>
        <source>&amp;Delete</source>
        <translation type="unfinished"></translation>
    </message>
    <message>
        <source>Delete the current element</source>
        <translation type="unfinished"></translation>
    </message>
    <message>
        <source>&amp;Apply</source>
        <translation type="unfinished"></translation>
    </message>
    <message>
        <source>Write the changes</source>
        <translation type="unfinished"></translation>
    </message>
    <message>
        <source>Ca&amp;ncel</source>
        <translation type="unfinished"></translation>
    </message>
    <message>
        <source>Forget the changes</source>
        <translation type="unfinished"></translation>
    </message>
    <message>
        <source>&amp;Reread</source>
        <translation type="unfinished"></translation>
    </message>
    <message>
        <source>Read the current element again from the system</source>
        <translation type="unfinished"></translation>
    </message>
    <message>
        <source>&amp;Plugins...</source>
        <translation type="unfinished"></translation>
    </message>
    <message>
        <source>&amp;Tasks...</source>
        <translation type="unfinished"></translation>
    </message>
    <message>
        <source>&amp;Quit</source>
        <translation type="unfinished"></translation>
    </message>
    <message>
        <source>&amp;File</source>
        <translation type="unfinished"></translation>
    </message>
    <message>
        <source>&amp;Element</source>
        <translation type="unfinished"></translation>
    </message>
    <message>
        <source>Element</source>
        <translation type="unfinished"></translation>
    </message>
    <message>
        <source>No plugin folder: %1</source>
        <translation type="unfinished"></translation>
    </message>
    <message>
        <source>%1 plugin files tried, %2 accepted, %3 modules</source>
        <translation type="unfinished"></translation>
    </message>
    <message>
        <source>Unsaved changes</source>
        <translation type="unfinished"></translation>
    </message>
    <message>
        <source>The new element is not created yet.
Create it before leaving?</source>
        <translation type="unfinished"></translation>
    </message>
    <message>
        <source>The changes to &quot;%1&quot; are not applied.
Apply them before leaving?</source>
        <translation type="unfinished"></translation>
    </message>
    <message>
        <source>Nothing can be created here.</source>
        <translation type="unfinished"></translation>
    </message>
    <message>
        <source>Delete</source>
        <translation type="unfinished"></translation>
    </message>
</context>
<context>
    <name>QObject</name>
    <message>
        <source>kvt-admin: plugin folder &quot;%1&quot; does not exist</source>
        <translation type="unfinished"></translation>
    </message>
    <message>
        <source>kvt-admin: window rendered to %1</source>
        <translation type="unfinished"></translation>
    </message>
    <message>
        <source>kvt-admin: cannot write %1</source>
        <translation type="unfinished"></translation>
    </message>
    <message>
        <source>Plugins</source>
        <translation type="unfinished"></translation>
    </message>
    <message>
        <source>These plugin folders do not exist:
%1</source>
        <translation type="unfinished"></translation>
    </message>
    <message>
        <source>kvt-admin: tasks still running at exit; waiting for them to stop</source>
        <translation type="unfinished"></translation>
    </message>
</context>
</TS>
