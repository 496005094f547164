/// \file
/// The collections of structured values that have no C++ class.
#pragma once
#include "tarnkiln/collections/AbstractPrimitiveCollection.h"
#include "tarnkiln/collections/GenericPrimitiveAssociativeInterface.h"
#include "tarnkiln/collections/GenericPrimitiveSequenceInterface.h"
#include "tarnkiln/meta/DataType.h"
#include "tarnkiln/meta/ReflectiveDataType.h"

#include <map>
#include <vector>

namespace tarn::kiln {

/// Holds the container and the data type of its entries.
///
/// A value is refused with `CannotCastIncompatibleTypes` (qualified name of the data type) unless
/// it is a single one of that very type; it may have either form. A change announces itself but
/// opens no transaction, in contrast to that of other collections.
///
/// \tparam Container  of `ReflectiveDataType`s, perhaps behind keys.
template <class Container>
class TARNKILN_EXPORT ReflectiveDataTypeCollection : public AbstractPrimitiveCollection
{
public:
    /// In the order of the container.
    Container const& getEntries() const { return m_entries; }

    // AbstractOwnedCollection
    meta::Type getCollectionType() const override { return m_dataType; }
    void copyContents(AbstractOwnedCollection const& other) override;
    void basicSwapContents(AbstractOwnedCollection& other) noexcept override
    {
        m_entries.swap(static_cast<ReflectiveDataTypeCollection&>(other).m_entries);
    }
    void basicDropContents() noexcept override { m_entries.clear(); }
    // AbstractPrimitiveCollection
    void clear() override;
    std::size_t size() const override { return m_entries.size(); }
    std::vector<Value> getAllValues() const override;

protected:
    /// \param owner  empty makes a snapshot.
    ReflectiveDataTypeCollection(meta::DataType const& dataType, ModelElement const& owner,
                                 meta::Property const& property);

    void checkEntry(Value const& value) const;

    meta::DataType const m_dataType;
    Container m_entries;
};

extern template class TARNKILN_EXPORT ReflectiveDataTypeCollection<std::vector<ReflectiveDataType>>;

/// Structured values in the order in which they were put there; equal ones as often as they were.
///
/// Positions count from 0 and are trusted.
class TARNKILN_EXPORT ReflectiveDataTypeSequence
    : public ReflectiveDataTypeCollection<std::vector<ReflectiveDataType>>,
      public GenericPrimitiveSequenceInterface
{
public:
    /// \param owner  empty makes a snapshot.
    ReflectiveDataTypeSequence(meta::DataType const& dataType, ModelElement const& owner,
                               meta::Property const& property);
    ~ReflectiveDataTypeSequence() override;

    // AbstractPrimitiveCollection
    void genericAdd(Value const& value) override;
    void genericRemove(Value const& value) override;
    GenericPrimitiveInterface* getGenericInterface() const override;
    int getKind() const override { return SEQUENCE; }
    // GenericPrimitiveSequenceInterface
    Value genericAt(unsigned long index) override;
    void genericInsert(Value const& value, unsigned long index) override;
    void genericReplace(Value const& value, unsigned long index) override;
    void genericRemoveAt(unsigned long index) override;
    int genericIndexOf(Value const& value) const override;

private:
    using Position = std::vector<ReflectiveDataType>::const_iterator;

    Position positionOf(Value const& value) const;
};

/// Structured values by the key that one of their fields is.
///
/// | Key property | `K` |
/// |---|---|
/// | a primitive type | the C++ type that carries its values |
/// | an enumeration | `int` |
///
/// Odd, and meant so: with unique keys, a value under a taken one is dropped silently; and a
/// removal passes over the entry behind each one that it erases.
///
/// \tparam K  one of `TARNKILN_FOR_EACH_DATATYPE_KEY`.
template <class K>
class TARNKILN_EXPORT ReflectiveDataTypeAssociative
    : public ReflectiveDataTypeCollection<std::multimap<K, ReflectiveDataType>>,
      public GenericPrimitiveAssociativeInterface
{
    using Base = ReflectiveDataTypeCollection<std::multimap<K, ReflectiveDataType>>;

public:
    /// \param qualifier  the property of `dataType` that is the key.
    /// \param owner      empty makes a snapshot.
    ReflectiveDataTypeAssociative(meta::DataType const& dataType, meta::Property const& qualifier,
                                  ModelElement const& owner, meta::Property const& property,
                                  bool qualificationUnique);
    ~ReflectiveDataTypeAssociative() override;

    bool isQualificationUnique() const { return m_qualificationUnique; }

    // AbstractPrimitiveCollection
    void genericAdd(Value const& value) override;
    void genericRemove(Value const& value) override;
    GenericPrimitiveInterface* getGenericInterface() const override;
    int getKind() const override { return AbstractPrimitiveCollection::ASSOCIATIVE; }
    // GenericPrimitiveAssociativeInterface
    std::vector<Value> genericFind(Value const& key) override;
    std::vector<Value> genericKeys() const override;
    meta::Type getKeyType() const override;

private:
    using Base::m_entries;

    K keyOf(ReflectiveDataType const& entry) const;

    meta::Property const m_qualifier;
    bool const m_qualificationUnique;
};

/// Calls `X(K)` for each type of keys.
#define TARNKILN_FOR_EACH_DATATYPE_KEY(X)                                                          \
    X(::tarn::kiln::ustring)                                                                       \
    X(::tarn::kiln::string)                                                                        \
    X(int)                                                                                         \
    X(signed char)                                                                                 \
    X(short)                                                                                       \
    X(long)                                                                                        \
    X(unsigned int)                                                                                \
    X(unsigned char)                                                                               \
    X(unsigned short)                                                                              \
    X(unsigned long)                                                                               \
    X(::tarn::kiln::UUID)

#define TARNKILN_DECLARE(K)                                                                        \
    extern template class TARNKILN_EXPORT                                                          \
        ReflectiveDataTypeCollection<std::multimap<K, ReflectiveDataType>>;                        \
    extern template class TARNKILN_EXPORT ReflectiveDataTypeAssociative<K>;
TARNKILN_FOR_EACH_DATATYPE_KEY(TARNKILN_DECLARE)
#undef TARNKILN_DECLARE
}  // namespace tarn::kiln
