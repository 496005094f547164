/// \file
/// How the registry starts, and its locks.
#include "tarnkiln/meta/MetaRegistry.h"

#include "tarnkiln/kernel/ListenerHolder.h"
#include "tarnkiln/kernel/ModelConstellation.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/meta/StandardTypes.h"
#include "tarnkiln/meta/internal/MetaRegistryUsageProvider.h"
#include "tarnkiln/meta/internal/RegistryReading.h"
#include "tarnkiln/meta/internal/UnregisterDestroyedTypes.h"

#include <atomic>

namespace tarn::kiln::meta {
namespace {

std::atomic<MetaRegistry*> startedRegistry{nullptr};

/// Guarded by the start-up lock: the registry that a thread is making, seen by that thread only.
MetaRegistry* startingRegistry = nullptr;

/// How many `LockedModel`s this thread holds.
constinit thread_local int changersHere = 0;

/// Recursive, so that what runs at the start may ask for the registry that is being made. A thread
/// that holds the registry's own lock finds the registry started and never waits for this one.
std::recursive_mutex& startUpMutex()
{
    static std::recursive_mutex mutex;
    return mutex;
}

/// Shows the registry to its own start, whichever way that ends.
class StartScope
{
public:
    explicit StartScope(MetaRegistry* registry) { startingRegistry = registry; }
    StartScope(StartScope const&) = delete;
    StartScope& operator=(StartScope const&) = delete;
    ~StartScope() { startingRegistry = nullptr; }
};
}  // namespace

// Static objects of clients may use the registry, so this text is there before all of them.
[[gnu::init_priority(101)]] ustring const MetaRegistry::MetaRegistryModelID =
    u"registry@registry://metaRegistry/model";

MetaRegistry& MetaRegistry::getInstance()
{
    if (MetaRegistry* const registry = startedRegistry.load(std::memory_order_acquire))
        return *registry;
    return start();
}

/// Kept out of the way of those who find it started.
[[gnu::noinline]] MetaRegistry& MetaRegistry::start()
{
    std::lock_guard const lock(startUpMutex());
    if (startingRegistry)
        return *startingRegistry;
    if (MetaRegistry* const registry = startedRegistry.load(std::memory_order_relaxed))
        return *registry;
    auto* const registry = new MetaRegistry;
    startedRegistry.store(registry, std::memory_order_release);
    return *registry;
}

bool MetaRegistry::isStarted()
{
    return startedRegistry.load(std::memory_order_acquire) != nullptr;
}

MetaRegistry::MetaRegistry()
    : m_model(Model::createRegistryModel(MetaRegistryModelID)),
      m_freezer(m_model->freeze()),
      m_published(std::make_unique<internal::Published<Directory>>())
{
    StartScope const scope(this);
    m_model->setUsageProvider(std::make_unique<internal::MetaRegistryUsageProvider>());
    LockedModel const locked(*this);
    Transaction const transaction = m_model->beginTransaction(/*revertible=*/false);
    initialize();
    transaction.commit();
}

MetaRegistry::~MetaRegistry() = default;

void MetaRegistry::initialize()
{
    StandardTypes::initializeTypes(*this);
    Model::initializeType(*this);
    ModelElement::initializeType(*this);
    ModelConstellation::initializeType(*this);
    m_unregisterDestroyedTypes = std::make_unique<internal::UnregisterDestroyedTypes>(*this);
    m_model->addShallowListener(m_unregisterDestroyedTypes.get());
    m_initialised = true;
}

bool MetaRegistry::isChangedHere()
{
    return changersHere != 0;
}

MetaRegistry::LockedModel::LockedModel(MetaRegistry& registry)
    : m_registry(registry),
      m_lock(registry.m_mutex),
      m_model(registry.m_model),
      m_thawer(registry.m_freezer.thaw())
{
    ++m_registry.m_changers;
    ++changersHere;
}

MetaRegistry::LockedModel::~LockedModel()
{
    if (m_registry.m_changers == 1)
    {
        m_registry.publish();
        m_registry.shareDirectory();
    }
    --changersHere;
    --m_registry.m_changers;
}

MetaRegistry::LockedConstModel::LockedConstModel(MetaRegistry const& registry)
    : m_lock(registry.m_mutex),
      m_model(registry.m_model)
{}

MetaRegistry::LockedConstModel::~LockedConstModel() = default;
}  // namespace tarn::kiln::meta
