#include "schema/fixfieldlist.h"

#include <algorithm>
#include <new>

#include "schema/fixfield.h"

FIXFieldList::FIXFieldList() : items(new (std::nothrow) FIXField*[kGrowth]) {
    if (items != nullptr) capacity = kGrowth;
}

FIXFieldList::~FIXFieldList() {
    clear();
    delete[] items;
}

FIXField* FIXFieldList::append(FIXField* node) {
    if (count >= capacity) {
        auto** grown = new (std::nothrow) FIXField*[static_cast<size_t>(capacity) + kGrowth];
        if (grown == nullptr) return nullptr;
        std::copy(items, items + count, grown);
        delete[] items;
        items = grown;
        capacity += kGrowth;
    }
    if (node == nullptr) {
        node = new (std::nothrow) FIXField;
        if (node == nullptr) return nullptr;
    }
    items[count++] = node;
    return node;
}

void FIXFieldList::removeAt(int32_t index) {
    if (index < 0 || index >= count) return;
    delete items[index];
    std::copy(items + index + 1, items + count, items + index);
    --count;
}

void FIXFieldList::dropLast() {
    if (count > 0) --count;
}

void FIXFieldList::clear() {
    for (int32_t i = 0; i < count; ++i) delete items[i];
    count = 0;
}
