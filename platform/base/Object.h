#pragma once

#include <memory>
#include <string>
#include <utility>

#include "platform/base/Api.h"

namespace ktr::platform {

/// The root of everything that is shared: views, controllers, records, assistant objects.
/// Owned by std::shared_ptr always; made with `create`, never on the stack.
class KTR_API Object : public std::enable_shared_from_this<Object> {
  public:
    Object() = default;
    virtual ~Object();
    Object(const Object&) = delete;
    Object& operator=(const Object&) = delete;

    /// What "%@" shows of the object in a log line. Never none.
    virtual std::string description() const;
};

/// A strong reference to `self`. Not to be called in a constructor or a destructor.
template <class T>
std::shared_ptr<T> strong(T* self) {
    return std::static_pointer_cast<T>(self->shared_from_this());
}

/// A weak reference to `self`, for handlers that must not keep it alive. None in a constructor or a destructor.
template <class T>
std::weak_ptr<T> weak(T* self) {
    auto locked = self->weak_from_this().lock();
    // Moved, not cast: views hand out many of these, and each count is an atomic operation.
    return locked ? std::shared_ptr<T>(std::move(locked), self) : std::shared_ptr<T>();
}

/// Creates a T and runs its initialiser in one step; none when the initialiser says no. Initialisers are virtual
/// members that run after construction, since they call overridden operations and hand out weak references to the
/// object.
template <class T, class C, class... Parameters, class... Arguments>
std::shared_ptr<T> create(bool (C::*initialiser)(Parameters...), Arguments&&... arguments) {
    auto object = std::make_shared<T>();
    if (!(object.get()->*initialiser)(std::forward<Arguments>(arguments)...)) {
        return nullptr;
    }
    return object;
}

}  // namespace ktr::platform
