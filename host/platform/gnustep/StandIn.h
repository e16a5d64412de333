// Standing in for a method of the toolkit.
#pragma once

#include <objc/runtime.h>

namespace tessel
{
// Replaces the method and answers the toolkit's own, or null where there is no such method.
//
// The runtime keeps every method under one type of function; which one it is, its name tells.
template <class Function>
Function standInFor(const char* className, SEL selector, Function replacement)
{
    const Method method = class_getInstanceMethod(objc_getClass(className), selector);
    if (!method)
        return nullptr;
    const auto untyped = reinterpret_cast<void*>(replacement);
    return reinterpret_cast<Function>(
        reinterpret_cast<void*>(method_setImplementation(method, reinterpret_cast<IMP>(untyped))));
}

// The same for a method that the class inherits: the classes that it inherits from keep it.
template <class Function>
Function overrideIn(const char* className, SEL selector, Function replacement)
{
    const Class target = objc_getClass(className);
    const Method inherited = class_getInstanceMethod(target, selector);
    if (!inherited)
        return nullptr;
    const auto untyped = reinterpret_cast<void*>(replacement);
    const auto toolkits = reinterpret_cast<void*>(method_getImplementation(inherited));
    class_addMethod(target, selector, reinterpret_cast<IMP>(untyped), method_getTypeEncoding(inherited));
    return reinterpret_cast<Function>(toolkits);
}
} // namespace tessel
