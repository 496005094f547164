#include "tarnkiln/kernel/internal/Slabs.h"

#include "tarnkiln/Assert.h"
#include "tarnkiln/support/SharedCount.h"

#include <cstdint>
#include <new>
#include <utility>

namespace tarn::kiln::internal {
namespace {

/// Where an object was; keeps the next such place of the slab.
struct Hole
{
    Hole* next;
};

constexpr std::align_val_t ALIGNMENT{Slabs::SLAB_SIZE};
/// Leaves what allocators put before each block, so that slabs can lie side by side.
constexpr std::size_t SLAB_BYTES = Slabs::SLAB_SIZE - 2 * sizeof(void*);
/// The first slab; each further one is twice as large until they are `SLAB_BYTES`.
constexpr std::size_t FIRST_BYTES = Slabs::SLAB_SIZE / 8;
constexpr std::size_t LARGEST = FIRST_BYTES / 2;

#if defined(__SANITIZE_ADDRESS__)
constexpr bool IS_IN_SLABS = false;
#else
constexpr bool IS_IN_SLABS = true;
#endif

/// Holds the mutex, unless the process has but one thread.
class Locked
{
public:
    explicit Locked(std::mutex& mutex) : m_lock(mutex, std::defer_lock)
    {
        if (!support::isOnlyThread())
            m_lock.lock();
    }

private:
    std::unique_lock<std::mutex> m_lock;
};
}  // namespace

/// Lies at the begin of its memory, which is aligned to `SLAB_SIZE`; the objects follow.
struct Slabs::Slab : Linked<Slab>
{
    Slab(Slabs* of, std::size_t bytes) : owner(of), end(static_cast<std::uint32_t>(bytes)) {}
    static Slab* make(Slabs* owner, std::size_t bytes)
    {
        return new (::operator new(bytes, ALIGNMENT)) Slab(owner, bytes);
    }
    static void destroy(Slab* slab) noexcept { ::operator delete(slab, ALIGNMENT); }
    static Slab& of(void* object) noexcept
    {
        auto const place = reinterpret_cast<std::uintptr_t>(object) % SLAB_SIZE;
        return *reinterpret_cast<Slab*>(static_cast<std::byte*>(object) - place);
    }

    bool hasRoom(std::size_t size) const { return holes || fresh + size <= end; }
    void* take(std::size_t size)
    {
        ++used;
        if (holes)
            return std::exchange(holes, holes->next);
        return reinterpret_cast<std::byte*>(this) + std::exchange(fresh, fresh + size);
    }

    Slabs* owner;  ///< Null: it has one large object.
    Hole* holes = nullptr;
    std::uint32_t fresh = sizeof(Slab);  ///< From here on there has been no object.
    std::uint32_t end;
    std::uint32_t used : 31 = 0;
    std::uint32_t isListed : 1 = false;  ///< Among those of its owner that have room.
};

Slabs::~Slabs()
{
    while (Slab* const slab = m_withRoom.first())
    {
        TARNKILN_ASSERT(slab->used == 0, "the objects have gone", slab->used);
        m_withRoom.erase(*slab);
        Slab::destroy(slab);
    }
}

void* Slabs::allocate(std::size_t size)
{
    if constexpr (!IS_IN_SLABS)
        return ::operator new(size);
    if (size > LARGEST)
        return Slab::make(nullptr, sizeof(Slab) + size)->take(size);

    Locked const locked(m_mutex);
    if (!m_withRoom.first())
        grow();
    Slab& slab = *m_withRoom.first();
    void* const object = slab.take(size);
    slab.isListed = slab.hasRoom(size);
    if (!slab.isListed)
        m_withRoom.erase(slab);
    return object;
}

void Slabs::grow()
{
    std::size_t const bytes = m_count < 3 ? FIRST_BYTES << m_count : SLAB_BYTES;
    m_withRoom.insert(*Slab::make(this, bytes));
    ++m_count;
}

void Slabs::free(void* object) noexcept
{
    if constexpr (!IS_IN_SLABS)
        return ::operator delete(object);
    Slab& slab = Slab::of(object);
    if (!slab.owner)
        return Slab::destroy(&slab);
    if (Slab* const empty = slab.owner->giveBack(slab, object))
        Slab::destroy(empty);
}

Slabs::Slab* Slabs::giveBack(Slab& slab, void* object) noexcept
{
    Locked const locked(m_mutex);
    slab.holes = new (object) Hole{slab.holes};
    if (!slab.isListed)
        m_withRoom.insert(slab);
    slab.isListed = true;
    if (--slab.used != 0 || m_withRoom.isOnly(slab))
        return nullptr;
    m_withRoom.erase(slab);
    --m_count;
    return &slab;
}
}  // namespace tarn::kiln::internal
