/// \file
/// How changes of the registry become visible to other threads.
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/meta/MetaRegistry.h"
#include "tarnkiln/meta/internal/RegistryReading.h"

#include <new>
#include <utility>

namespace tarn::kiln::meta {

/// Only the thread that changes may see it before it has ended.
void MetaRegistry::directoryChanged()
{
    m_directoryChanged = true;
    if (m_changers == 0)
        shareDirectory();
}

void MetaRegistry::shareDirectory() noexcept
{
    if (!std::exchange(m_directoryChanged, false))
        return;
    std::shared_ptr<Directory const> copy;
    try
    {
        copy = std::make_shared<Directory const>(m_directory);
    }
    catch (std::bad_alloc const&)
    {
        // Without a copy, readers take the lock.
    }
    m_published->publish(std::move(copy));
}
}  // namespace tarn::kiln::meta
