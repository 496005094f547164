#include "tarnkiln/support/RowPackage.h"

#include "tarnkiln/Assert.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/kernel/Transaction.h"
#include "tarnkiln/meta/PackageImpl.h"
#include "tarnkiln/meta/internal/PackageWalker.h"

#include <boost/lexical_cast.hpp>
#include <boost/uuid/uuid_io.hpp>

#include <stdexcept>

namespace tarn::kiln::support {
namespace {

/// Takes away what an earlier instance of the metamodel has left in the registry.
void destroyStaleRoot(meta::AbstractMetaPackage const& package, Model const& model, UUID const& id)
{
    meta::Package const stale = meta::Package::cast(model->findElement(id));
    if (!stale)
        return;
    Transaction const transaction = model->beginTransaction(/*revertible=*/true);
    package.unregisterRootPackage(stale->getUri());
    stale->destroy();
    transaction.commit();
}
}  // namespace

/// Marks the package as being built and, unless that succeeds, as not built.
class RowPackage::Attempt
{
public:
    explicit Attempt(RowPackage& package) : m_package(package) { set(State::Building); }
    Attempt(Attempt const&) = delete;
    Attempt& operator=(Attempt const&) = delete;
    ~Attempt()
    {
        if (m_package.isBuilt())
            return;
        m_package.m_elements.clear();
        set(State::None);
    }

    void succeed() { set(State::Built); }

private:
    void set(State state) { m_package.m_state.store(state, std::memory_order_release); }

    RowPackage& m_package;
};

RowPackage::RowPackage(PackageRows const& rows) : m_rows(rows), m_elements(rows) {}

RowPackage::~RowPackage() = default;

void RowPackage::completed() {}

void RowPackage::build()
{
    meta::MetaRegistry& registry = meta::MetaRegistry::getInstance();
    if (!meta::MetaRegistry::isStarted())
        return;  // on the thread that starts it
    meta::MetaRegistry::LockedModel const locked(registry);
    if (m_state.load(std::memory_order_relaxed) != State::None)
        return;
    Attempt attempt(*this);
    // Each in a transaction of its own, and before there is one that it could join.
    for (void (*const import)() : m_rows.imports)
        import();
    initialize(locked.getModel());
    completed();
    attempt.succeed();
}

void RowPackage::initialize(Model const& model)
{
    TARNKILN_ASSERT(!m_rows.packages.empty() && m_rows.packages.front().uuid,
                    "the root package is found again by its UUID");
    destroyStaleRoot(*this, model, boost::lexical_cast<UUID>(m_rows.packages.front().uuid));

    Transaction const transaction = model->beginTransaction(/*revertible=*/true);
    internal::PackageWalker walker(*this, m_rows, m_elements);
    walker.createElements();
    walker.connectAndRegister();
    if (transaction.commit() == TransactionResult::RolledBack)
        throw std::runtime_error("the elements of a metamodel were refused by a listener");
    registerRootPackage(getRootPackage());
}
}  // namespace tarn::kiln::support
