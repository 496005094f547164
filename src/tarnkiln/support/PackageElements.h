/// \file
/// The elements that stand for the rows of a metamodel.
#pragma once
#include "tarnkiln/meta/Argument.h"
#include "tarnkiln/meta/Class.h"
#include "tarnkiln/meta/DataType.h"
#include "tarnkiln/meta/Enum.h"
#include "tarnkiln/meta/EnumLiteral.h"
#include "tarnkiln/meta/Operation.h"
#include "tarnkiln/meta/Package.h"
#include "tarnkiln/meta/PrimitiveType.h"
#include "tarnkiln/meta/Property.h"
#include "tarnkiln/support/PackageRows.h"

#include <vector>

namespace tarn::kiln::support {

/// A handle for each row, by its number; empty until its element is made. The handles stay where
/// they are.
struct PackageElements
{
    explicit PackageElements(PackageRows const& rows)
        : packages(rows.packages.size()),
          primitiveTypes(rows.primitiveTypes.size()),
          classes(rows.classes.size()),
          dataTypes(rows.dataTypes.size()),
          properties(rows.properties.size()),
          operations(rows.operations.size()),
          arguments(rows.arguments.size()),
          enumerations(rows.enumerations.size()),
          literals(rows.literals.size())
    {}

    /// Empties all handles.
    void clear() noexcept
    {
        auto const empty = [](auto& table) {
            for (auto& handle : table)
                handle = {};
        };
        empty(packages);
        empty(primitiveTypes);
        empty(classes);
        empty(dataTypes);
        empty(properties);
        empty(operations);
        empty(arguments);
        empty(enumerations);
        empty(literals);
    }

    std::vector<meta::Package> packages;
    std::vector<meta::PrimitiveType> primitiveTypes;
    std::vector<meta::Class> classes;
    std::vector<meta::DataType> dataTypes;
    std::vector<meta::Property> properties;
    std::vector<meta::Operation> operations;
    std::vector<meta::Argument> arguments;
    std::vector<meta::Enum> enumerations;
    std::vector<meta::EnumLiteral> literals;
};
}  // namespace tarn::kiln::support
