// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "regexpprefilter_p.h"

#include <algorithm>

namespace {

using CharSet = std::bitset<128>;

const int maxStates = 4096;
const int maxRepeat = 100;
const int maxDepth = 64;

bool isPunctuation(ushort c)
{
    return c > 0x20 && c < 0x7f && !((c >= '0' && c <= '9') || (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z'));
}

CharSet rangeSet(int from, int to)
{
    CharSet set;
    for (int c = from; c <= to; ++c)
        set.set(size_t(c));
    return set;
}

CharSet digitSet() { return rangeSet('0', '9'); }
CharSet spaceSet() { return rangeSet('\t', '\r') | rangeSet(' ', ' '); }
CharSet wordSet() { return rangeSet('0', '9') | rangeSet('a', 'z') | rangeSet('A', 'Z') | rangeSet('_', '_'); }

} // namespace

struct RegExpPrefilter::Node
{
    enum Type { Set, Begin, End, Concat, Alternation, Repeat } type = Concat;
    CharSet set;
    std::vector<Node> children;
    int min = 0;
    int max = 0; // -1: unbounded
};

namespace {

struct Reader
{
    const QString &p;
    int i = 0;
    int depth = 0;

    bool atEnd() const { return i >= p.size(); }
    ushort peek(int ahead = 0) const { return i + ahead < p.size() ? p.at(i + ahead).unicode() : 0; }
};

bool readNumber(Reader &r, int &value)
{
    if (!(r.peek() >= '0' && r.peek() <= '9'))
        return false;
    value = 0;
    while (r.peek() >= '0' && r.peek() <= '9') {
        value = value * 10 + (r.peek() - '0');
        if (value > maxRepeat)
            return false;
        ++r.i;
    }
    return true;
}

// A literal inside a bracket set: a plain character or escaped punctuation.
bool readSetLiteral(Reader &r, int &c)
{
    const ushort first = r.peek();
    if (first == '\\') {
        if (!isPunctuation(r.peek(1)))
            return false;
        c = r.peek(1);
        r.i += 2;
        return true;
    }
    // '-', '^' and '[' have special meanings in some dialects; only plain
    // printable characters are taken as they are.
    if (first < 0x20 || first > 0x7e || first == '-' || first == '^' || first == '[' || first == ']')
        return false;
    c = first;
    ++r.i;
    return true;
}

bool readSet(Reader &r, CharSet &set)
{
    ++r.i; // '['
    bool negated = false;
    if (r.peek() == '^') {
        negated = true;
        ++r.i;
    }
    set.reset();
    bool any = false;
    while (r.peek() != ']') {
        if (r.atEnd())
            return false;
        int low = 0;
        if (!readSetLiteral(r, low))
            return false;
        int high = low;
        if (r.peek() == '-' && r.peek(1) != ']') {
            ++r.i;
            if (!readSetLiteral(r, high) || high < low)
                return false;
        }
        set |= rangeSet(low, high);
        any = true;
    }
    ++r.i; // ']'
    if (!any)
        return false;
    if (negated)
        set.flip();
    return true;
}

} // namespace

namespace {

// Recursive-descent reader of the subset: any construct outside it fails.
struct SubsetParser
{
    using Node = RegExpPrefilter::Node;

    static bool alternation(Reader &r, Node &out)
    {
        if (++r.depth > maxDepth)
            return false;
        Node branch;
        if (!concatenation(r, branch))
            return false;
        if (r.peek() != '|') {
            out = std::move(branch);
            --r.depth;
            return true;
        }
        out = Node();
        out.type = Node::Alternation;
        out.children.push_back(std::move(branch));
        while (r.peek() == '|') {
            ++r.i;
            Node next;
            if (!concatenation(r, next))
                return false;
            out.children.push_back(std::move(next));
        }
        --r.depth;
        return true;
    }

    static bool concatenation(Reader &r, Node &out)
    {
        out = Node();
        out.type = Node::Concat;
        while (!r.atEnd() && r.peek() != '|' && r.peek() != ')') {
            Node atomNode;
            if (!atom(r, atomNode))
                return false;
            const ushort q = r.peek();
            if (q == '*' || q == '+' || q == '?' || q == '{') {
                if (atomNode.type == Node::Begin || atomNode.type == Node::End)
                    return false;
                Node repeat;
                repeat.type = Node::Repeat;
                if (!quantifier(r, repeat.min, repeat.max))
                    return false;
                const ushort after = r.peek();
                // Lazy and possessive forms differ between dialects.
                if (after == '*' || after == '+' || after == '?' || after == '{')
                    return false;
                repeat.children.push_back(std::move(atomNode));
                out.children.push_back(std::move(repeat));
            } else {
                out.children.push_back(std::move(atomNode));
            }
        }
        return true;
    }

    static bool quantifier(Reader &r, int &min, int &max)
    {
        const ushort q = r.peek();
        ++r.i;
        switch (q) {
        case '*': min = 0; max = -1; return true;
        case '+': min = 1; max = -1; return true;
        case '?': min = 0; max = 1; return true;
        default: break;
        }
        if (!readNumber(r, min))
            return false;
        max = min;
        if (r.peek() == ',') {
            ++r.i;
            if (r.peek() == '}')
                max = -1;
            else if (!readNumber(r, max) || max < min)
                return false;
        }
        if (r.peek() != '}')
            return false;
        ++r.i;
        return true;
    }

    static bool atom(Reader &r, Node &out)
    {
        out = Node();
        const ushort c = r.peek();
        switch (c) {
        case '(': {
            ++r.i;
            if (r.peek() == '?') {
                if (r.peek(1) != ':')
                    return false;
                r.i += 2;
            }
            if (!alternation(r, out) || r.peek() != ')')
                return false;
            ++r.i;
            return true;
        }
        case '[':
            out.type = Node::Set;
            return readSet(r, out.set);
        case '.':
            ++r.i;
            out.type = Node::Set;
            out.set.set();
            return true;
        case '^':
            ++r.i;
            out.type = Node::Begin;
            return true;
        case '$':
            ++r.i;
            out.type = Node::End;
            return true;
        case '\\': {
            const ushort e = r.peek(1);
            r.i += 2;
            out.type = Node::Set;
            switch (e) {
            case 'd': out.set = digitSet(); return true;
            case 'D': out.set = ~digitSet(); return true;
            case 's': out.set = spaceSet(); return true;
            case 'S': out.set = ~spaceSet(); return true;
            case 'w': out.set = wordSet(); return true;
            case 'W': out.set = ~wordSet(); return true;
            default:
                if (!isPunctuation(e))
                    return false;
                out.set.set(e);
                return true;
            }
        }
        case '*': case '+': case '?': case '{': case '}': case ']':
            return false;
        default:
            if (c < 0x20 || c > 0x7e)
                return false;
            ++r.i;
            out.type = Node::Set;
            out.set.set(c);
            return true;
        }
    }
};

} // namespace

bool RegExpPrefilter::usable(const QRegExp &regExp)
{
    const QString pattern = regExp.pattern();
    const bool subsetSyntax = (regExp.patternSyntax() == QRegExp::RegExp || regExp.patternSyntax() == QRegExp::RegExp2)
                              && regExp.caseSensitivity() == Qt::CaseSensitive;
    if (!_known || pattern != _pattern) {
        _known = true;
        _pattern = pattern;
        _usable = regExp.isValid() && build(pattern);
    }
    return _usable && subsetSyntax;
}

bool RegExpPrefilter::build(const QString &pattern)
{
    _states.clear();
    Reader reader{pattern};
    Node root;
    if (!SubsetParser::alternation(reader, root) || !reader.atEnd())
        return false;
    State match;
    match.kind = State::Match;
    const int matchState = addState(match);
    _start = compile(root, matchState);
    if (_start < 0 || int(_states.size()) > maxStates)
        return false;
    _marks.assign(_states.size(), 0);
    _generation = 0;

    // Probe a position inside a text, and the end of one.
    nextGeneration();
    _current.clear();
    _startsInside = follow(_start, 1, 2, _current) || !_current.empty();
    nextGeneration();
    _current.clear();
    _matchesAtEnd = follow(_start, 1, 1, _current);
    return true;
}

int RegExpPrefilter::addState(State state)
{
    _states.push_back(std::move(state));
    return int(_states.size()) - 1;
}

// Builds the automaton back to front: every piece is compiled with the state
// that follows it already known.
int RegExpPrefilter::compile(const Node &node, int next)
{
    if (next < 0 || int(_states.size()) > maxStates)
        return -1;
    switch (node.type) {
    case Node::Set: {
        State s;
        s.kind = State::Char;
        s.set = node.set;
        s.out = {next};
        return addState(std::move(s));
    }
    case Node::Begin:
    case Node::End: {
        State s;
        s.kind = node.type == Node::Begin ? State::Begin : State::End;
        s.out = {next};
        return addState(std::move(s));
    }
    case Node::Concat:
        for (auto it = node.children.rbegin(); it != node.children.rend(); ++it)
            next = compile(*it, next);
        return next;
    case Node::Alternation: {
        State s;
        s.kind = State::Split;
        for (const Node &child : node.children)
            s.out.push_back(compile(child, next));
        for (int out : s.out) {
            if (out < 0)
                return -1;
        }
        return addState(std::move(s));
    }
    case Node::Repeat: {
        const Node &child = node.children.front();
        int tail = next;
        if (node.max < 0) {
            State loop;
            loop.kind = State::Split;
            const int loopState = addState(std::move(loop));
            const int body = compile(child, loopState);
            if (body < 0)
                return -1;
            _states[size_t(loopState)].out = {body, next};
            tail = loopState;
        } else {
            for (int k = node.min; k < node.max; ++k) {
                State optional;
                optional.kind = State::Split;
                const int body = compile(child, tail);
                if (body < 0)
                    return -1;
                optional.out = {body, next};
                tail = addState(std::move(optional));
            }
        }
        for (int k = 0; k < node.min; ++k)
            tail = compile(child, tail);
        return tail;
    }
    }
    return -1;
}

// Adds \a state and everything reachable from it without reading a
// character to \a list; true when that reaches the final state.
bool RegExpPrefilter::follow(int state, int position, int size, std::vector<int> &list)
{
    _stack.clear();
    _stack.push_back(state);
    while (!_stack.empty()) {
        const int s = _stack.back();
        _stack.pop_back();
        if (_marks[size_t(s)] == _generation)
            continue;
        _marks[size_t(s)] = _generation;
        const State &st = _states[size_t(s)];
        switch (st.kind) {
        case State::Match:
            return true;
        case State::Char:
            list.push_back(s);
            break;
        case State::Begin:
            if (position == 0)
                _stack.push_back(st.out.front());
            break;
        case State::End:
            if (position == size)
                _stack.push_back(st.out.front());
            break;
        case State::Split:
            _stack.insert(_stack.end(), st.out.rbegin(), st.out.rend());
            break;
        }
    }
    return false;
}

void RegExpPrefilter::nextGeneration()
{
    if (++_generation == 0) {
        std::fill(_marks.begin(), _marks.end(), 0u);
        _generation = 1;
    }
}

bool RegExpPrefilter::canMatch(const char *text, int size)
{
    _current.clear();
    nextGeneration();
    for (int i = 0;; ++i) {
        // A match may start at any position, unless the expression is
        // anchored to the start.
        if ((i == 0 || i == size || _startsInside) && follow(_start, i, size, _current))
            return true;
        if (i == size)
            return false;
        if (_current.empty() && !_startsInside && !_matchesAtEnd)
            return false;
        const unsigned char c = static_cast<unsigned char>(text[i]);
        if (c >= 128)
            return true; // not ASCII: let QRegExp decide
        _next.clear();
        nextGeneration();
        for (int s : _current) {
            const State &st = _states[size_t(s)];
            if (st.set[c] && follow(st.out.front(), i + 1, size, _next))
                return true;
        }
        _current.swap(_next);
    }
}
