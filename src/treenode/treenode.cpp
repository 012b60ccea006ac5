// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "treenode.h"

#include <QMetaObject>
#include <QSet>
#include <QtAlgorithms>

#include <algorithm>
#include <array>
#include <type_traits>
#include <cstdlib>
#include <vector>

namespace {

// Where each node was last seen in its parent's list. The hints live outside
// the node so that the class layout stays fixed. A hint is only a guess that
// is verified before use, so a stale entry (a node destroyed in another thread
// than the one that looked it up) costs memory, never correctness.
//
// An open-addressing table keeps key and row in one slot: a lookup of a node
// among many thousands costs one cache line, as a hint stored in the node
// itself would.
//
// The table has no destructor of its own, so its storage stays valid for the
// whole life of its thread: nodes destroyed late (static objects destroyed at
// exit, after the thread's own objects) still reach it. A separate releaser
// frees the slots when the thread ends and marks the table closed; a closed
// table answers "no hint" and records nothing more.
class RowHints
{
public:
    void release()
    {
        std::free(m_slots);
        m_slots = nullptr;
        m_mask = 0;
        m_count = 0;
        m_shift = 64;
        m_closed = true;
    }

    int value(const TreeNode *node) const
    {
        if (!m_slots)
            return -1;
        for (std::size_t i = slotOf(node);; i = (i + 1) & m_mask) {
            const Slot &slot = m_slots[i];
            if (slot.node == node)
                return slot.row;
            if (!slot.node)
                return -1;
        }
    }

    void insert(const TreeNode *node, int row)
    {
        if (m_closed)
            return;
        if ((m_count + 1) * 2 > m_mask + 1)
            grow();
        for (std::size_t i = slotOf(node);; i = (i + 1) & m_mask) {
            Slot &slot = m_slots[i];
            if (slot.node == node) {
                slot.row = row;
                return;
            }
            if (!slot.node) {
                slot = Slot{node, row};
                ++m_count;
                return;
            }
        }
    }

    void remove(const TreeNode *node)
    {
        if (!m_slots)
            return;
        std::size_t hole = slotOf(node);
        while (m_slots[hole].node != node) {
            if (!m_slots[hole].node)
                return;
            hole = (hole + 1) & m_mask;
        }
        // Shift later members of the probe run back into the hole, so that
        // lookups never need tombstones.
        for (std::size_t i = (hole + 1) & m_mask; m_slots[i].node; i = (i + 1) & m_mask) {
            const std::size_t home = slotOf(m_slots[i].node);
            if (((i - home) & m_mask) >= ((i - hole) & m_mask)) {
                m_slots[hole] = m_slots[i];
                hole = i;
            }
        }
        m_slots[hole] = Slot{};
        --m_count;
    }

private:
    struct Slot
    {
        const TreeNode *node = nullptr;
        int row = -1;
    };

    std::size_t slotOf(const TreeNode *node) const
    {
        return std::size_t((quint64(quintptr(node)) * Q_UINT64_C(0x9E3779B97F4A7C15)) >> m_shift) & m_mask;
    }

    void grow()
    {
        Slot *old = m_slots;
        const std::size_t oldSize = old ? m_mask + 1 : 0;
        const std::size_t size = oldSize ? oldSize * 2 : 64;
        m_slots = static_cast<Slot *>(std::calloc(size, sizeof(Slot)));
        if (!m_slots)
            qBadAlloc();
        m_mask = size - 1;
        m_shift = 64 - qCountTrailingZeroBits(quint64(size));
        m_count = 0;
        for (std::size_t i = 0; i < oldSize; ++i) {
            if (old[i].node)
                insert(old[i].node, old[i].row);
        }
        std::free(old);
    }

    Slot *m_slots = nullptr;
    std::size_t m_mask = 0;
    std::size_t m_count = 0;
    int m_shift = 64;
    bool m_closed = false;
};

static_assert(std::is_trivially_destructible<RowHints>::value, "the row hints outlive the thread's other objects");

thread_local RowHints rowHints;

struct RowHintsReleaser
{
    ~RowHintsReleaser() { rowHints.release(); }
};
thread_local RowHintsReleaser rowHintsReleaser;

void rememberRow(const TreeNode *node, int row)
{
    // Registers this thread's releaser before the table first allocates.
    (void)&rowHintsReleaser;
    rowHints.insert(node, row);
}


} // namespace

TreeNode::TreeNode(QObject *parent)
    : TreeNode(-1, QString(), parent)
{
}

TreeNode::TreeNode(int expectedDepth, const QString &expectedParentId, QObject *parent)
    : QObject(parent)
    , _parentNode(nullptr)
    , _expectedParentId(expectedParentId)
    , _expectedDepth(expectedDepth)
{
}

TreeNode::~TreeNode()
{
    reset();
    rowHints.remove(this);
}

void TreeNode::insert(int position, const QList<TreeNode *> &nodes)
{
    // Nulls, this node itself and repeated pointers are dropped. A single
    // node, the usual case, needs no set of the ones seen.
    QList<TreeNode *> incoming;
    if (nodes.size() == 1) {
        if (nodes.first() && nodes.first() != this)
            incoming = nodes;
    } else {
        incoming.reserve(nodes.size());
        QSet<TreeNode *> seen;
        for (TreeNode *node : nodes) {
            if (node && node != this && !seen.contains(node)) {
                seen.insert(node);
                incoming.append(node);
            }
        }
    }
    if (incoming.isEmpty())
        return;

    // A node lives in one list at a time. Inserting a node that is still
    // attached elsewhere moves it, with the removal announced by its old
    // parent; otherwise it would sit in two lists and outlive one of them.
    for (TreeNode *node : qAsConst(incoming)) {
        if (node->_parentNode)
            node->_parentNode->removeOne(node);
    }

    if (position > 0)
        position = qMin(position, childNodesCount());
    else
        position = 0;
    const int count = incoming.size();

    Q_EMIT nodesAboutToBeInserted(this, position, position + count - 1);
    for (int i = 0; i < count; ++i)
        incoming.at(i)->setParentNode(this);
    if (position == _childNodes.size()) {
        _childNodes.append(incoming);
    } else {
        QList<TreeNode *> merged;
        merged.reserve(_childNodes.size() + count);
        merged.append(_childNodes.mid(0, position));
        merged.append(incoming);
        merged.append(_childNodes.mid(position));
        _childNodes.swap(merged);
    }
    for (int i = 0; i < count; ++i)
        rememberRow(incoming.at(i), position + i);
    Q_EMIT nodesInserted();

    // Connected only now, so that the announcement above is heard once.
    for (TreeNode *node : qAsConst(incoming))
        connectChildSignals(node);
}

void TreeNode::removeAt(int position, int count)
{
    const int size = childNodesCount();
    if (size == 0 || position < 0 || position >= size || count < 1)
        return;
    count = qMin(count, size - position);
    const int last = position + count - 1;

    for (int i = position; i <= last; ++i)
        disconnectChildSignals(_childNodes.at(i));

    Q_EMIT nodesAboutToBeRemoved(this, position, last);
    for (int i = position; i <= last; ++i)
        _childNodes.at(i)->setParentNode(nullptr);
    _childNodes.erase(_childNodes.begin() + position, _childNodes.begin() + last + 1);
    Q_EMIT nodesRemoved();
}

void TreeNode::setAlternativeExpected(int)
{
}

void TreeNode::afterLoad()
{
}

int TreeNode::treeNodeSpecialFlags() const
{
    return 0;
}

int TreeNode::columnCount() const
{
    return 0;
}

QVariant TreeNode::headerData(int, Qt::Orientation, int) const
{
    return QVariant();
}

QVariant TreeNode::data(int, int role) const
{
    switch (role) {
    case Qt::UserRole + 2:
        return _id;
    case Qt::UserRole + 3:
        return _expectedParentId;
    default:
        return QVariant();
    }
}

bool TreeNode::setData(int, const QVariant &, int)
{
    return false;
}

Qt::ItemFlags TreeNode::flags(int) const
{
    return Qt::ItemIsSelectable | Qt::ItemIsEnabled;
}

bool TreeNode::canFetchMore() const
{
    return false;
}

void TreeNode::fetchMore()
{
}

void TreeNode::append(TreeNode *node)
{
    insert(childNodesCount(), QList<TreeNode *>{node});
}

void TreeNode::append(const QList<TreeNode *> &nodes)
{
    insert(childNodesCount(), nodes);
}

void TreeNode::insert(int position, TreeNode *node)
{
    insert(position, QList<TreeNode *>{node});
}

void TreeNode::clear()
{
    removeAt(0, childNodesCount());
}

void TreeNode::clearDelete()
{
    const QList<TreeNode *> children = _childNodes;
    clear();
    qDeleteAll(children);
}

void TreeNode::clearDeleteAll()
{
    const QList<TreeNode *> children = _childNodes;
    clear();
    for (TreeNode *child : children) {
        child->clearDeleteAll();
        delete child;
    }
}

bool TreeNode::contains(TreeNode *node) const
{
    return _childNodes.contains(node);
}

int TreeNode::indexOf(TreeNode *node, int from) const
{
    return _childNodes.indexOf(node, from);
}

bool TreeNode::removeOne(TreeNode *node)
{
    // The first occurrence, searched from the start: a list that a subclass
    // filled with a repeated pointer loses the first one.
    const int index = _childNodes.indexOf(node);
    if (index < 0)
        return false;
    removeAt(index, 1);
    return true;
}

void TreeNode::reset()
{
    if (_parentNode)
        _parentNode->removeOne(this);
    clear();
}

QList<TreeNode *> TreeNode::allChildNodes() const
{
    QList<TreeNode *> result = _childNodes;
    for (const TreeNode *child : _childNodes)
        result.append(child->_childNodes);
    return result;
}

void TreeNode::loadTreeFromList(const QList<TreeNode *> &nodes)
{
    clear();

    // Sorted through a compact array of keys. The first four UTF-16 units of
    // each id are packed into an integer that orders like the string, so
    // most comparisons touch neither the nodes nor their string data: in a
    // list of many thousand nodes each such visit is a cache miss.
    struct Key
    {
        int depth;
        int length;
        quint64 prefix;
        const QString *id;
        TreeNode *node;
    };
    constexpr int prefixLength = 4;
    std::vector<Key> keys;
    keys.reserve(std::size_t(nodes.size()));
    for (TreeNode *node : nodes) {
        if (!node)
            continue;
        const QString &id = node->_id;
        quint64 prefix = 0;
        for (int i = 0; i < prefixLength; ++i)
            prefix = (prefix << 16) | (i < id.size() ? id.at(i).unicode() : 0u);
        keys.push_back(Key{node->_expectedDepth, id.size(), prefix, &id, node});
    }
    std::sort(keys.begin(), keys.end(), [](const Key &a, const Key &b) {
        if (a.depth != b.depth)
            return a.depth < b.depth;
        if (a.prefix != b.prefix)
            return a.prefix < b.prefix;
        // Equal prefixes: ids of up to four units are then told apart by
        // their length alone (a shorter id is a prefix of the longer one,
        // which the zero padding cannot distinguish from a real U+0000).
        if (a.length <= prefixLength && b.length <= prefixLength)
            return a.length < b.length;
        return *a.id < *b.id;
    });
    QList<TreeNode *> list;
    list.reserve(int(keys.size()) + 1);
    list.append(this);
    for (const Key &key : keys)
        list.append(key.node);

    int currentDepth = _expectedDepth;
    int levelStart = 0;
    int previousLevelStart = -1;
    // First node of the previous level for each id, so that a level of many
    // parents is not scanned once per child. Only the first match counts, as
    // a linear scan in list order would find.
    QHash<QString, TreeNode *> previousLevel;
    QList<TreeNode *> attached;

    for (int i = 1; i < list.size(); ++i) {
        TreeNode *node = list.at(i);
        if (node->_expectedDepth != currentDepth) {
            currentDepth = node->_expectedDepth;
            previousLevelStart = levelStart;
            levelStart = i;
            previousLevel.clear();
            for (int j = qMax(previousLevelStart, 0); j < levelStart; ++j) {
                TreeNode *candidate = list.at(j);
                // Candidates all share one depth except the root at index 0.
                if (candidate->_expectedDepth + 1 == currentDepth
                    && !previousLevel.contains(candidate->_id))
                    previousLevel.insert(candidate->_id, candidate);
            }
        }
        TreeNode *parent = previousLevel.value(node->_expectedParentId);
        if (parent) {
            parent->append(node);
            attached.append(node);
        }
    }

    for (TreeNode *node : qAsConst(attached))
        node->afterLoad();
}

namespace {

// Method indexes of the eight notification signals, looked up once. Each
// child signal is connected to the parent's signal of the same index, which
// is exactly the connection that the SIGNAL() form makes (either form can
// break it). Going by index skips the signature parsing and argument checks
// of the string and QMetaMethod forms: a tree of many thousand nodes makes
// eight connections per node, and those checks were most of their cost.
const std::array<int, 8> &notificationSignals()
{
    static const std::array<int, 8> indexes = [] {
        const char *const signatures[] = {
            "nodesAboutToBeInserted(TreeNode*,int,int)",
            "nodesAboutToBeRemoved(TreeNode*,int,int)",
            "nodesInserted()",
            "nodesRemoved()",
            "nodeDataChanged(TreeNode*)",
            "nodeChildsDataChanged(TreeNode*)",
            "setCurrentNode(TreeNode*)",
            "expandCurrentNode(TreeNode*)",
        };
        std::array<int, 8> result{};
        const QMetaObject &meta = TreeNode::staticMetaObject;
        for (std::size_t i = 0; i < result.size(); ++i) {
            result[i] = meta.indexOfSignal(signatures[i]);
            Q_ASSERT(result[i] >= 0);
        }
        return result;
    }();
    return indexes;
}

} // namespace

void TreeNode::connectChildSignals(TreeNode *child)
{
    if (!child)
        return;
    for (const int signal : notificationSignals())
        QMetaObject::connect(child, signal, this, signal, Qt::AutoConnection);
}

void TreeNode::disconnectChildSignals(TreeNode *child)
{
    if (!child)
        return;
    for (const int signal : notificationSignals())
        QMetaObject::disconnect(child, signal, this, signal);
}

int TreeNode::row() const
{
    if (!_parentNode)
        return -1;
    const QList<TreeNode *> &siblings = _parentNode->_childNodes;
    const int size = siblings.size();
    const int hint = rowHints.value(this);
    if (hint >= 0 && hint < size && siblings.at(hint) == this)
        return hint;

    // Search outwards from the hint: an insertion or removal nearby shifts a
    // node by a few rows, so it is usually found within a few steps.
    const int start = qBound(0, hint, size - 1);
    for (int distance = 0; distance < size; ++distance) {
        const int above = start - distance;
        const int below = start + distance;
        if (above < 0 && below >= size)
            break;
        if (below < size && siblings.at(below) == this) {
            rememberRow(this, below);
            return below;
        }
        if (above >= 0 && siblings.at(above) == this) {
            rememberRow(this, above);
            return above;
        }
    }
    return -1;
}

void TreeNode::emitNodeDataChanged()
{
    Q_EMIT nodeDataChanged(this);
}

void TreeNode::emitNodeChildsDataChanged()
{
    Q_EMIT nodeChildsDataChanged(this);
}

void TreeNode::emitSetCurrentNode()
{
    Q_EMIT setCurrentNode(this);
}

void TreeNode::emitExpandCurrentNode()
{
    Q_EMIT expandCurrentNode(this);
}
