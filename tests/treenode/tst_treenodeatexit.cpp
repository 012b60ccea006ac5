// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

// Tree nodes that are static objects are destroyed at exit, after the objects
// of the main thread itself. Leaving their parent then must not touch memory
// the library has already released. The run passes when the process exits
// cleanly; CTest runs it with freed memory scribbled over (MALLOC_PERTURB_),
// so a late read or write hangs or crashes it.

#include <kvt-common/treenode.h>

#include <cstdio>

namespace {

TreeNode staticParent(nullptr);
TreeNode staticChild(nullptr); // destroyed first, still in staticParent's list

} // namespace

int main()
{
    // Enough siblings that the library's bookkeeping of rows outgrows the
    // small blocks that the allocator keeps unscribbled. The siblings belong
    // to the parent and die with it.
    QList<TreeNode *> siblings;
    for (int i = 0; i < 500; ++i)
        siblings.append(new TreeNode(&staticParent));
    staticParent.append(siblings);
    staticParent.insert(250, &staticChild);
    if (staticChild.parentNode() != &staticParent || staticParent.childNodesCount() != 501) {
        std::fprintf(stderr, "FAIL: the tree was not built\n");
        return 1;
    }
    std::printf("PASS: tree built; the check is the clean exit\n");
    return 0;
}
