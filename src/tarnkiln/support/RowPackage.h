/// \file
/// The base of generated meta packages: a metamodel that is built from rows at its first use.
#pragma once
#include "tarnkiln/meta/AbstractMetaPackage.h"
#include "tarnkiln/support/PackageElements.h"
#include "tarnkiln/support/PackageRows.h"

#include <atomic>
#include <cstddef>

namespace tarn::kiln::support {

/// Builds a metamodel in the registry once, and holds the handles of its elements.
///
/// A derived class is a singleton whose `getInstance` calls `ensureBuilt`:
///
///     LibraryPackage& LibraryPackage::getInstance()
///     {
///         static auto* const package = new LibraryPackage;  // reaches no lock
///         package->ensureBuilt();
///         return *package;
///     }
///
/// Threads: any. The first thread builds under the registry's lock and the others wait for it; a
/// call on the building thread returns at once and finds the handles that there are. A failure
/// takes everything back, and the next call tries again.
class TARNKILN_EXPORT RowPackage : public meta::AbstractMetaPackage
{
public:
    /// \name The elements, by the number of their row; empty while they are not made
    /// @{
    meta::Package const& getPackage(std::size_t row) const { return m_elements.packages[row]; }
    meta::PrimitiveType const& getPrimitiveType(std::size_t row) const
    {
        return m_elements.primitiveTypes[row];
    }
    meta::Class const& getClass(std::size_t row) const { return m_elements.classes[row]; }
    meta::DataType const& getDataType(std::size_t row) const { return m_elements.dataTypes[row]; }
    meta::Property const& getProperty(std::size_t row) const { return m_elements.properties[row]; }
    meta::Operation const& getOperation(std::size_t row) const
    {
        return m_elements.operations[row];
    }
    meta::Argument const& getArgument(std::size_t row) const { return m_elements.arguments[row]; }
    meta::Enum const& getEnum(std::size_t row) const { return m_elements.enumerations[row]; }
    meta::EnumLiteral const& getEnumLiteral(std::size_t row) const
    {
        return m_elements.literals[row];
    }
    /// @}

    meta::Package const& getRootPackage() const { return getPackage(0); }
    /// Whether all elements are there. Builds nothing.
    bool isBuilt() const { return m_state.load(std::memory_order_acquire) == State::Built; }

protected:
    explicit RowPackage(PackageRows const& rows);
    ~RowPackage() override;

    /// Builds the metamodel unless that was done. While the registry itself starts, nothing is
    /// built and the handles stay empty.
    ///
    /// \throws tarnkiln::messages::NoSuchType  (name) if a type that a row names is not registered.
    /// \throws boost::bad_lexical_cast  if the UUID of a row is none.
    /// \throws std::runtime_error  if a listener of the registry's model refuses the metamodel.
    void ensureBuilt()
    {
        if (!isBuilt())
            build();
    }

    /// Called when all elements are committed and before other threads see them. Does nothing by
    /// itself.
    virtual void completed();

private:
    enum class State
    {
        None,
        Building,
        Built
    };
    class Attempt;

    void build();
    void initialize(Model const& model);

    PackageRows const& m_rows;
    PackageElements m_elements;
    std::atomic<State> m_state{State::None};  ///< Changed under the registry's lock.
};

/// The property of a row of `MetaPackage`, for the `Slot` of a generated class.
template <class MetaPackage, std::size_t ROW> meta::Property const& propertyAt()
{
    return MetaPackage::getInstance().getProperty(ROW);
}
}  // namespace tarn::kiln::support
