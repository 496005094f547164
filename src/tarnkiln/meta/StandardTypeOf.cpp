#include "tarnkiln/meta/StandardTypeOf.h"

#include "tarnkiln/kernel/Model.h"
#include "tarnkiln/kernel/Types.h"
#include "tarnkiln/meta/ExtensionPrototype.h"
#include "tarnkiln/meta/Language.h"
#include "tarnkiln/meta/MetaRegistry.h"
#include "tarnkiln/meta/StandardTypes.h"
#include "tarnkiln/meta/TransactionOrigin.h"

#include <boost/date_time/posix_time/posix_time_types.hpp>

#include <atomic>
#include <memory>
#include <type_traits>

namespace tarn::kiln::meta {
namespace {

/// A type of the metamodel's own package. Once found it is kept to the end of the process.
class CatalogueType
{
public:
    explicit constexpr CatalogueType(char16_t const* name) : m_name(name) {}

    Type const& get()
    {
        static Type const NONE;
        if (Type const* const known = m_type.load(std::memory_order_acquire))
            return *known;
        Type const found = MetaRegistry::getInstance().getType(m_name);
        if (!found)
            return NONE;
        auto mine = std::make_unique<Type const>(found);
        Type const* known = nullptr;
        if (m_type.compare_exchange_strong(known, mine.get(), std::memory_order_acq_rel))
            known = mine.release();
        return *known;
    }

private:
    char16_t const* const m_name;
    std::atomic<Type const*> m_type = nullptr;
};

constinit CatalogueType modelType(u"tarn.kiln.TarnModel");
constinit CatalogueType transactionOriginType(u"tarn.kiln.meta.TransactionOrigin");
constinit CatalogueType extensionPrototypeType(u"tarn.kiln.meta.ExtensionPrototype");
constinit CatalogueType languageType(u"tarn.kiln.meta.Language");
}  // namespace

#define TARNKILN_STANDARD_TYPE(T, TYPE)                                                            \
    template <> TARNKILN_EXPORT Type const& standardTypeOf<T>()                                    \
    {                                                                                              \
        StandardTypes::ensureInitialized();                                                        \
        return TYPE;                                                                               \
    }

TARNKILN_STANDARD_TYPE(ustring, StandardTypes::stringMeta)
TARNKILN_STANDARD_TYPE(int, StandardTypes::integerMeta)
TARNKILN_STANDARD_TYPE(signed char, StandardTypes::integer8Meta)
TARNKILN_STANDARD_TYPE(short, StandardTypes::integer16Meta)
TARNKILN_STANDARD_TYPE(long, StandardTypes::integer64Meta)
TARNKILN_STANDARD_TYPE(double, StandardTypes::realMeta)
TARNKILN_STANDARD_TYPE(bool, StandardTypes::booleanMeta)
TARNKILN_STANDARD_TYPE(unsigned int, StandardTypes::unlimitedNaturalMeta)
TARNKILN_STANDARD_TYPE(unsigned char, StandardTypes::uinteger8Meta)
TARNKILN_STANDARD_TYPE(unsigned short, StandardTypes::uinteger16Meta)
TARNKILN_STANDARD_TYPE(unsigned long, StandardTypes::uinteger64Meta)
TARNKILN_STANDARD_TYPE(UUID, StandardTypes::uuidMeta)
TARNKILN_STANDARD_TYPE(boost::posix_time::ptime, StandardTypes::dateTimeMeta)
TARNKILN_STANDARD_TYPE(string, StandardTypes::stdstringMeta)
TARNKILN_STANDARD_TYPE(Model, modelType.get())
TARNKILN_STANDARD_TYPE(TransactionOrigin, transactionOriginType.get())
TARNKILN_STANDARD_TYPE(ExtensionPrototype, extensionPrototypeType.get())
TARNKILN_STANDARD_TYPE(Language, languageType.get())
}  // namespace tarn::kiln::meta
