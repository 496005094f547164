/// \file
/// Memory for many objects of one size.
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/kernel/internal/LinkedList.h"

#include <cstddef>
#include <mutex>

namespace tarn::kiln::internal {

/// Memory for objects of one size, which lie side by side in slabs.
///
/// What is made in succession lies in succession, and has no header of its own. A slab goes back
/// when it is empty, unless no other one has room. The first slabs are small; large objects have
/// one each.
///
/// Under the address sanitizer each object is allocated by itself, so that it sees who uses one
/// that is gone.
///
/// Threads: any. As long as the process has one thread, nothing is locked.
class TARNKILN_TESTED Slabs
{
public:
    static constexpr std::size_t SLAB_SIZE = 16 * 1024;

    Slabs() = default;
    /// All objects must have gone.
    ~Slabs();
    Slabs(Slabs const&) = delete;
    Slabs& operator=(Slabs const&) = delete;

    /// Room for one object, aligned for pointers.
    ///
    /// \param size  the same at each call; a multiple of the size of a pointer.
    /// \throws std::bad_alloc  if there is no memory; nothing has changed then.
    void* allocate(std::size_t size);
    /// Gives back what `allocate` of any `Slabs`, which must still be there, returned.
    static void free(void* object) noexcept;

private:
    struct Slab;

    void grow();
    /// The slab, if it is to be destroyed.
    Slab* giveBack(Slab& slab, void* object) noexcept;

    std::mutex m_mutex;
    LinkedList<Slab> m_withRoom;
    std::size_t m_count = 0;  ///< Of all slabs.
};
}  // namespace tarn::kiln::internal
