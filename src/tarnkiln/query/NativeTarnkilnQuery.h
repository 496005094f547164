/// \file
/// The query that is run in memory, by the library itself.
#pragma once
#include "tarnkiln/query/RetargetableQuery.h"

namespace tarn::kiln::internal {
class NativeResultSet;
struct NativeQueryState;
}  // namespace tarn::kiln::internal

namespace tarn::kiln::query {

/// A query over the elements that a model has in memory.
///
/// Nothing is kept from one run to the next: each sees the model as it then stands. It may be run
/// any number of times, and opens no transaction.
///
/// Threads: as `ReflectiveQuery`.
class TARNKILN_EXPORT NativeTarnkilnQuery final : public RetargetableQuery
{
public:
    class NativeResultIterator;  // internal/NativeResultIterator.h

    /// Gives the rows of a query, of the columns asked for or of all.
    using Engine = internal::NativeResultSet (*)(internal::NativeQueryState const& query,
                                                 std::vector<std::size_t> const& columns);

    /// \param model  may be empty, until `setModel`.
    explicit NativeTarnkilnQuery(Model const& model);
    ~NativeTarnkilnQuery() override;

    /// Lets `engine` find the rows; null stands for the library's own. For tests, which compare the
    /// two.
    void useEngine(Engine engine);

    // ReflectiveQuery
    void reset() override;
    std::size_t addSearchClass(meta::Class const& searchClass, SearchClassMatchMode mode) override;
    void addValueConstraint(meta::Property const& property, ValueMatchRelation relation,
                            Value const& value, std::size_t instance) override;
    void addPropertyRelation(meta::Property const& left, ValueMatchRelation relation,
                             meta::Property const& right, std::size_t leftInstance,
                             std::size_t rightInstance) override;
    void addTopLevelConstraint(std::size_t instance) override;
    void addAssociatedObjectConstraint(meta::Property const& property, std::size_t source,
                                       std::size_t target) override;
    void setResultLimit(std::size_t limit) override;
    void setResultOffset(std::size_t offset) override;
    std::vector<ModelElement> getFirstResult(std::vector<std::size_t> const& columns) override;
    std::unique_ptr<ResultIterator>
    getResultIterator(std::vector<std::size_t> const& columns) override;
    std::size_t getResultCount() override;

    // RetargetableQuery
    void setModel(Model const& model) override;
    void retargetTo(RetargetableQuery& target) const override;
    Model getModel() const override;

private:
    void requireRunnable() const;
    internal::NativeResultSet run(std::vector<std::size_t> const& columns, std::size_t most) const;

    std::unique_ptr<internal::NativeQueryState> const m_state;
    Engine m_engine = nullptr;
};

/// A query without a model.
TARNKILN_EXPORT std::unique_ptr<NativeTarnkilnQuery> createNativeQuery();
TARNKILN_EXPORT std::unique_ptr<NativeTarnkilnQuery> createNativeQuery(Model const& model);
}  // namespace tarn::kiln::query
