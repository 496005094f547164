/// \file
/// The base of everything that stands behind a handle.
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/collections/Fwd.h"
#include "tarnkiln/kernel/Fwd.h"
#include "tarnkiln/kernel/Types.h"
#include "tarnkiln/meta/Fwd.h"
#include "tarnkiln/support/SharedCount.h"

#include <atomic>
#include <cstdint>

namespace tarn::kiln {

/// An object with an identity, a reference count and a validity, reached through handles only.
///
/// The count decides how long the object stays in memory, the validity whether it still exists in
/// its model. A destroyed element stays in memory, `Invalid`, while a handle or a transaction that
/// may yet bring it back refers to it.
///
/// Threads: the reference count is atomic; everything else belongs to the thread of the model.
class TARNKILN_EXPORT ElementImpl
{
public:
    enum class ElementValidity : signed char
    {
        Invalid = 0,          ///< Destroyed, or rolled back out of existence: handles test false.
        Constructing = 1,     ///< Not yet announced to its model; reflective proxies stay so.
        Valid = 2,            ///< Live: changes are recorded.
        ModelDestroying = 3,  ///< A model that is being destroyed.
        BuilderProxy = -1     ///< A proxy that a builder made.
    };

    /// Called with (element, null) when an element dies and with (null, collection) or
    /// (element, collection) when a collection does.
    using InvalidateCallback = void (*)(ElementImpl*, AbstractOwnedCollection*);

    /// Stands in the count from the start of destruction, so that a late reference shows.
    static constexpr std::uint32_t REFCOUNT_DELETING = 0xDEAD;

    ElementImpl(ElementImpl const&) = delete;
    ElementImpl& operator=(ElementImpl const&) = delete;
    virtual ~ElementImpl();

    /// The model that the object belongs to, or is; empty if there is none.
    virtual Model getModel() const = 0;
    /// The class that describes the object; empty while there is none.
    virtual meta::Class const& getMetaClass() const = 0;
    /// Gives one reference back; the last one deletes the object.
    virtual void removeRef();
    /// Makes the object `Invalid` and tells the invalidate callback.
    virtual void invalidate();

    void addRef()
    {
        if (!isPermanent())
            m_refCount.increment();
    }
    /// The same as `removeRef`, without a call where nothing is counted.
    void release()
    {
        if (!isPermanent())
            removeRef();
    }
    /// Of a permanent object: some count from before it became one.
    std::uint32_t getRefCount() const { return m_refCount.get(); }

    /// \name Permanent objects
    /// Types that all threads share are not counted: the count would be the one word that all of
    /// them write. They stay in memory to the end of the process, dead or not.
    ///
    /// Threads: any; an object may become permanent while others count it.
    /// @{
    bool isPermanent() const { return m_isPermanent.load(std::memory_order_relaxed); }
    void makePermanent();
    /// @}

    UUID const& getUuid() const { return m_uuid; }
    ElementValidity getValidity() const { return m_validity; }
    bool isLive() const { return m_validity != ElementValidity::Invalid; }

    /// Installs the process-wide callback by which a host drops its mirrors of dead elements.
    /// The first call wins. Call it before other threads use the library.
    static void setInvalidateCallback(InvalidateCallback callback);

    /// A random UUID of version 4 from the calling thread's own generator.
    ///
    /// \throws std::exception  if the system has no random device.
    static UUID generateNewUuid();

protected:
    /// \param id  the nil UUID stands for a fresh one.
    ElementImpl(UUID const& id, ElementValidity validity);

    /// Runs `delete this`, deferred when called from within the deletion of a long chain.
    void deleteThis();

    static InvalidateCallback m_callback;

    UUID m_uuid;
    support::SharedCount m_refCount;
    ElementValidity m_validity;

private:
    std::atomic<bool> m_isPermanent{false};
};
}  // namespace tarn::kiln
