#include "reader/DependencyKind.h"

namespace debian {

std::string_view fieldName(DependencyKind kind)
{
    switch (kind)
    {
    case DependencyKind::PreDepends:
        return "Pre-Depends";
    case DependencyKind::Depends:
        return "Depends";
    case DependencyKind::Recommends:
        return "Recommends";
    case DependencyKind::Suggests:
        return "Suggests";
    case DependencyKind::Conflicts:
        return "Conflicts";
    case DependencyKind::Breaks:
        return "Breaks";
    case DependencyKind::Replaces:
        return "Replaces";
    case DependencyKind::Enhances:
        return "Enhances";
    }
    return {};
}

bool allowsAlternatives(DependencyKind kind)
{
    return kind != DependencyKind::Conflicts && kind != DependencyKind::Breaks &&
           kind != DependencyKind::Replaces;
}

}  // namespace debian
