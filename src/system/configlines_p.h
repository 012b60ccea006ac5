// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_CONFIGLINES_P_H
#define KVT_CONFIGLINES_P_H

#include <functional>

class QByteArray;
class QIODevice;
class RegExpHandler;

// The line handling of the configuration-file traversals, apart from the
// files themselves: what RegExpHandler reads and writes between opening and
// closing them.
namespace KvtConfigLines {

// Calls handler.handleRegExp(nullptr) for every matching line of \a in.
void readLines(QIODevice &in, RegExpHandler &handler);

// Gives \a write, block by block, the new version of \a in: unmatched lines
// byte for byte, matching lines as the handler leaves them (with their
// comment put back when it replaced them), then the handler's tail. Stops
// and returns false as soon as \a write does; read errors stay in the
// device's error state.
bool rewriteLines(QIODevice &in, RegExpHandler &handler, const std::function<bool(const QByteArray &)> &write);

} // namespace KvtConfigLines

#endif // KVT_CONFIGLINES_P_H
