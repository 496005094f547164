/// \file
/// Objects that go with the last handle to them.
#pragma once
#include "tarnkiln/support/SharedCount.h"

namespace tarn::kiln::support {

/// Base of a class `T` whose objects are made by `new` and counted by `CountedPointer`; the last
/// one who lets go deletes. A destructor that is to be called by nobody else is private, with this
/// as a friend.
///
/// Threads: handles may be copied and dropped anywhere.
template <class T> class Shared
{
public:
    Shared(Shared const&) = delete;
    Shared& operator=(Shared const&) = delete;

    void addRef() const { m_refCount.increment(); }
    void removeRef() const
    {
        if (m_refCount.decrement())
            delete static_cast<T const*>(this);
    }

protected:
    Shared() = default;
    ~Shared() = default;

private:
    mutable SharedCount m_refCount;
};
}  // namespace tarn::kiln::support
