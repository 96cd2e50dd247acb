#include "schema/fixfield.h"

#include <new>

#include "schema/fixfieldlist.h"

FIXField::FIXField() : format(u"String") {}

FIXField::~FIXField() {
    delete children;
}

FIXField* FIXField::addChild(FIXField* child) {
    if (children == nullptr) {
        children = new (std::nothrow) FIXFieldList;
        if (children == nullptr) return nullptr;
    }
    return children->append(child);
}
