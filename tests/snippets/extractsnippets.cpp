// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

// Build tool of tst_snippets: copies the code blocks of Markdown files that
// carry a marker line "<!-- snippet: NAME -->" into files the test compiles.
//
//   extractsnippets OUTDIR PRELUDE GLOBALS BODIES FILE.md...
//
// GLOBALS and BODIES are comma-separated snippet names. The global snippets
// (class declarations, which moc must see in a header) are written one after
// the other into OUTDIR/globalsnippets.h, after an #include of PRELUDE; every
// other snippet (function definitions, statements) is written to
// OUTDIR/NAME.inc for the sources to include where it belongs. Every listed name must appear exactly once and every marked
// block must be listed, so a snippet cannot silently drop out of the check.

#include <cstdio>
#include <fstream>
#include <iostream>
#include <map>
#include <set>
#include <sstream>
#include <string>
#include <vector>

namespace {

std::vector<std::string> splitNames(const std::string &list)
{
    std::vector<std::string> names;
    std::stringstream stream(list);
    std::string name;
    while (std::getline(stream, name, ','))
        if (!name.empty())
            names.push_back(name);
    return names;
}

bool startsWith(const std::string &text, const std::string &prefix)
{
    return text.compare(0, prefix.size(), prefix) == 0;
}

// Reads every marked block of \a path into \a snippets; false on an error,
// which is printed.
bool readSnippets(const std::string &path, std::map<std::string, std::string> &snippets)
{
    std::ifstream in(path);
    if (!in) {
        std::cerr << path << ": cannot be read\n";
        return false;
    }
    const std::string marker = "<!-- snippet: ";
    std::string line;
    int lineNumber = 0;
    while (std::getline(in, line)) {
        ++lineNumber;
        if (!startsWith(line, marker))
            continue;
        const std::string::size_type end = line.find(" -->", marker.size());
        if (end == std::string::npos) {
            std::cerr << path << ":" << lineNumber << ": marker without \" -->\"\n";
            return false;
        }
        const std::string name = line.substr(marker.size(), end - marker.size());
        if (!std::getline(in, line) || !startsWith(line, "```cpp")) {
            std::cerr << path << ":" << lineNumber << ": snippet " << name
                      << " is not followed by a ```cpp block\n";
            return false;
        }
        ++lineNumber;
        const int start = lineNumber;
        std::string code;
        bool closed = false;
        while (std::getline(in, line)) {
            ++lineNumber;
            if (startsWith(line, "```")) {
                closed = true;
                break;
            }
            code += line + "\n";
        }
        if (!closed) {
            std::cerr << path << ":" << start << ": snippet " << name << " is not closed\n";
            return false;
        }
        if (!snippets.emplace(name, "#line " + std::to_string(start + 1) + " \"" + path + "\"\n" + code).second) {
            std::cerr << path << ":" << start << ": snippet " << name << " appears twice\n";
            return false;
        }
    }
    return true;
}

bool writeFile(const std::string &path, const std::string &content)
{
    std::ofstream out(path);
    out << content;
    if (!out) {
        std::cerr << path << ": cannot be written\n";
        return false;
    }
    return true;
}

} // namespace

int main(int argc, char **argv)
{
    if (argc < 6) {
        std::cerr << "usage: extractsnippets OUTDIR PRELUDE GLOBALS BODIES FILE.md...\n";
        return 2;
    }
    const std::string outDir = argv[1];
    const std::string prelude = argv[2];
    const std::vector<std::string> globals = splitNames(argv[3]);
    const std::vector<std::string> bodies = splitNames(argv[4]);

    std::map<std::string, std::string> snippets;
    for (int i = 5; i < argc; ++i)
        if (!readSnippets(argv[i], snippets))
            return 1;

    std::set<std::string> listed(globals.begin(), globals.end());
    listed.insert(bodies.begin(), bodies.end());
    bool ok = true;
    for (const std::string &name : listed)
        if (!snippets.count(name)) {
            std::cerr << "snippet " << name << " not found in the documents\n";
            ok = false;
        }
    for (const auto &snippet : snippets)
        if (!listed.count(snippet.first)) {
            std::cerr << "snippet " << snippet.first << " is not compiled by any test\n";
            ok = false;
        }
    if (!ok)
        return 1;

    std::string header = "// Generated from the documentation by extractsnippets; do not edit.\n"
                         "#pragma once\n#include \"" + prelude + "\"\n";
    for (const std::string &name : globals)
        header += snippets[name];
    if (!writeFile(outDir + "/globalsnippets.h", header))
        return 1;
    for (const std::string &name : bodies)
        if (!writeFile(outDir + "/" + name + ".inc", snippets[name]))
            return 1;
    return 0;
}
