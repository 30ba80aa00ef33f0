#include "platform/foundation/CodingClass.h"

#include "platform/foundation/FoundationCoding.h"

#include <algorithm>

namespace orvo {

bool CodingClass::isKindOf(const std::string& className) const {
    return name == className || std::ranges::find(superclasses, className) != superclasses.end();
}

CodingClassTable::CodingClassTable(std::initializer_list<CodingClass> classes) {
    for (const auto& itsClass : classes)
        _classes.insert_or_assign(itsClass.name, itsClass);
    for (const auto& itsClass : FoundationCoding::classes())
        _classes.insert_or_assign(itsClass.name, itsClass);
}

const CodingClass* CodingClassTable::find(const std::string& name) const {
    const auto found = _classes.find(name);
    return found == _classes.end() ? nullptr : &found->second;
}

EnvironmentSlot<std::shared_ptr<const CodingClassTable>>& CodingClassTable::current() {
    static EnvironmentSlot<std::shared_ptr<const CodingClassTable>> slot(
        [] { return std::make_shared<const CodingClassTable>(); });
    return slot;
}

} // namespace orvo
