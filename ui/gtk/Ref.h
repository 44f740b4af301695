#pragma once

#include <glib-object.h>
#include <memory>

namespace pallax::gtk {

struct Unref {
    void operator()(gpointer object) const { g_object_unref(object); }
};

/// Owns one reference to an object of the toolkit.
template <class Object>
using Ref = std::unique_ptr<Object, Unref>;

/// Takes over a new object, whether its reference is floating or not.
template <class Object>
Ref<Object> owned(Object* object) {
    if (g_object_is_floating(object) != 0) {
        g_object_ref_sink(object);
    }
    return Ref<Object>(object);
}

/// Shares an object that somebody else owns.
template <class Object>
Ref<Object> shared(Object* object) {
    return Ref<Object>(static_cast<Object*>(g_object_ref(object)));
}

} // namespace pallax::gtk
