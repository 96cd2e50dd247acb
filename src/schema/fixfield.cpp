#include "schema/fixfield.h"

#include <new>
#include <vector>

#include "schema/fixfieldlist.h"

FIXField::FIXField() : format(u"String") {}

// Subtrees are taken apart without recursion: a schema may nest groups deeper than the
// stack could follow.
FIXField::~FIXField() {
    std::vector<FIXField*> pending;
    detachChildren(pending);
    while (!pending.empty()) {
        FIXField* node = pending.back();
        pending.pop_back();
        if (node == nullptr) continue;
        node->detachChildren(pending);
        delete node;
    }
}

void FIXField::detachChildren(std::vector<FIXField*>& out) {
    if (children == nullptr) return;
    for (int32_t i = children->getCount() - 1; i >= 0; --i) out.push_back(children->getAt(i));
    while (children->getCount() > 0) children->dropLast();
    delete children;
    children = nullptr;
}

FIXField* FIXField::addChild(FIXField* child) {
    if (children != nullptr) return children->append(child);
    // The list exists only once it holds a child, so a failure changes nothing.
    auto* list = new (std::nothrow) FIXFieldList;
    if (list == nullptr) return nullptr;
    FIXField* added = list->append(child);
    if (added == nullptr) {
        delete list;
        return nullptr;
    }
    children = list;
    return added;
}
