/// \file
/// How the registry is read by many threads at once.
#pragma once
#include "tarnkiln/meta/MetaRegistry.h"
#include "tarnkiln/meta/internal/Published.h"

#include <mutex>
#include <optional>

namespace tarn::kiln::meta {

/// A look at the registry's directory.
///
/// | Who looks | sees |
/// |---|---|
/// | the thread that holds a `LockedModel` | the directory as it stands |
/// | any other thread | the copy that was made after the last change ended |
///
/// The registry's lock is taken only if there was no memory for the copy.
class MetaRegistry::Reading
{
public:
    explicit Reading(MetaRegistry const& registry) : m_registry(registry)
    {
        if (isChangedHere())
            m_directory = &registry.m_directory;
        else
            m_directory = registry.m_published->find();
        if (m_directory)
            return;
        m_lock.emplace(registry.m_mutex);
        m_directory = &registry.m_directory;
    }
    Reading(Reading const&) = delete;
    Reading& operator=(Reading const&) = delete;

    Directory const* operator->() const { return m_directory; }

    /// What `find` gives, copied, or null; it is given the directory and gives a pointer. What is
    /// not there while another thread changes the registry is waited for.
    template <class Find> static auto find(MetaRegistry const& registry, Find const& find)
    {
        std::optional<std::remove_cvref_t<decltype(*find(registry.m_directory))>> result;
        auto const take = [&](auto const* found) {
            if (found)
                result = *found;
        };
        bool isFinal = false;
        {
            Reading const reading(registry);
            take(find(*reading.m_directory));
            isFinal = reading.isFinal();
        }
        if (!result && !isFinal)
        {
            std::lock_guard const lock(registry.m_mutex);
            take(find(registry.m_directory));
        }
        return result;
    }

private:
    bool isFinal() const
    {
        return m_lock || m_directory == &m_registry.m_directory ||
               (m_registry.m_changers == 0 && m_registry.m_published->isLatest(m_directory));
    }

    MetaRegistry const& m_registry;
    std::optional<std::lock_guard<std::recursive_mutex>> m_lock;
    Directory const* m_directory = nullptr;
};
}  // namespace tarn::kiln::meta
