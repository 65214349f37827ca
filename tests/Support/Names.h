/// \file
/// The names of the objects on a list, as plain texts that tests can compare.
#pragma once

#include "Orn_Hdl/Containers.h"
#include "Port/String.h"

#include <string>
#include <vector>

namespace Support {

using Names = std::vector<std::string>;

inline std::string Text(const Port::String& text) {
    return std::string(text.GetView());
}

/// The names of the objects that an iterator yields; a null is shown as "<null>".
template <class T> Names NamesOf(const Orn_Hdl::Iterator<T>& objects) {
    Names names;
    for (T object : objects) {
        names.push_back(object == nullptr ? "<null>" : Text(object->GetName()));
    }
    return names;
}

template <class T> Names NamesOf(const Orn_Hdl::PtrArray<T>& objects) {
    return NamesOf(Orn_Hdl::Iterator<T>(&objects));
}

/// The names of a set, in its order.
inline Names NamesOf(const Orn_Hdl::StringSet& set) {
    Names names;
    for (Orn_Hdl::StringSetIterator at = set.GetBeginPos(); at != set.GetEndPos(); ++at) {
        names.push_back(Text(*at));
    }
    return names;
}

inline Names NamesOf(const Orn_Hdl::StringArray& texts) {
    Names names;
    for (int i = 0; i < texts.GetSize(); ++i) {
        names.push_back(Text(texts.GetAt(i)));
    }
    return names;
}

/// The object on a list that has exactly this name; null when there is none.
template <class T> T Find(const Orn_Hdl::Iterator<T>& objects, const char* name) {
    for (T object : objects) {
        if (object != nullptr && object->GetName() == name) {
            return object;
        }
    }
    return nullptr;
}

} // namespace Support
