// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_REGEXPPREFILTER_P_H
#define KVT_REGEXPPREFILTER_P_H

#include <QRegExp>
#include <QString>

#include <bitset>
#include <vector>

/*
 * Tells quickly, for a line of pure ASCII text, that a QRegExp cannot match
 * it, so that the configuration-file traversals run QRegExp (which is slow,
 * and needed for the captures) only on lines that may match.
 *
 * Only expressions in a common subset are understood: literal characters,
 * escaped punctuation, ".", "\d \D \s \S \w \W", bracket sets of literals and
 * ranges, groups "(...)" and "(?:...)", "|", the anchors "^" and "$", and the
 * quantifiers "* + ? {n} {n,} {n,m}", case-sensitive. On ASCII text these mean
 * the same in every regular-expression dialect, and whether a match exists
 * does not depend on greedy or minimal matching. The expression is run as a
 * Thompson automaton, in time linear in the text. For anything else
 * usable() is false and QRegExp decides alone.
 */
class RegExpPrefilter
{
public:
    // Follows the handler's expression, which may change between lines.
    bool usable(const QRegExp &regExp);

    // False when the expression surely does not match \a text (ASCII only).
    bool canMatch(const char *text, int size);

    // The expression as read, before it becomes an automaton.
    struct Node;

private:
    struct State
    {
        enum Kind { Char, Split, Begin, End, Match } kind;
        std::bitset<128> set;
        std::vector<int> out;
    };

    bool build(const QString &pattern);
    int compile(const Node &node, int next);
    int addState(State state);
    bool follow(int state, int position, int size, std::vector<int> &list);
    void nextGeneration();

    QString _pattern;
    bool _known = false;
    bool _usable = false;
    std::vector<State> _states;
    int _start = 0;
    // Whether a match can begin inside the text, respectively at its end;
    // not so for an expression anchored with '^'.
    bool _startsInside = true;
    bool _matchesAtEnd = true;
    std::vector<int> _current;
    std::vector<int> _next;
    std::vector<int> _stack;
    std::vector<unsigned> _marks;
    unsigned _generation = 0;
};

#endif
