#include "ChangeReport.h"

#include "ElementText.h"
#include "OldValues.h"
#include "tarnkiln/kernel/ModelElementImpl.h"
#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/PropertyImpl.h"

#include "sill/i18n/StringConversion.h"

#include <algorithm>
#include <map>
#include <ostream>
#include <string>
#include <vector>

namespace debian {

using namespace tarn::kiln;
using sill::i18n::to_string;

namespace {

constexpr std::size_t MAX_MEMBERS = 3;

std::string classNameOf(ModelElement const& element)
{
    return to_string(element->getMetaClass()->getName());
}

template <ElementForm Form>
std::string listOf(std::vector<ModelElement> const& members, Before before)
{
    std::string text;
    for (std::size_t i = 0; i < members.size() && i < MAX_MEMBERS; ++i)
        text += (i == 0 ? "" : ", ") + textOf<Form>(members[i], before);
    if (members.size() > MAX_MEMBERS)
        text += ", and " + std::to_string(members.size() - MAX_MEMBERS) + " more";
    return '{' + text + '}';
}

/// Such as "providers = {mawk 1.3.4 amd64}", empty if the property held nothing.
template <ElementForm Form>
std::string oldValueText(ReportData const& report, ModelElement const& element,
                         meta::Property const& property)
{
    std::string const name = to_string(property->getName()) + " = ";
    if (isMany(property))
    {
        auto const members = oldMembers(report, element, property);
        return members.empty() ? std::string() : name + listOf<Form>(members, &report);
    }
    ModelElement const target = oldTarget(report, element, property);
    return target.getImpl() ? name + textOf<Form>(target, &report) : std::string();
}

template <ElementForm Form>
std::string lineOf(ReportData const& report, std::string const& verb, ModelElement const& element)
{
    std::string line = verb + ' ' + classNameOf(element) + ' ' + textOf<Form>(element, &report);
    char const* separator = "; had ";
    for (meta::Property const& property : propertiesOf(element->getMetaClass()))
    {
        bool const concerns = isReference(property) && !isContainer(property) &&
                              (!element || report.isChanged(element, property));
        std::string const old =
            concerns ? oldValueText<Form>(report, element, property) : std::string();
        if (old.empty())
            continue;
        line += separator + old;
        separator = ", ";
    }
    return line;
}

/// The elements class by class, in the order of their texts.
template <ElementForm Form>
std::vector<ModelElement> sorted(std::vector<ModelElement> const& elements, Before before)
{
    static std::string const ORDER[] = {"PackageIndex", "Package", "Release", "DependencyGroup"};
    std::multimap<std::pair<std::ptrdiff_t, std::string>, ModelElement> byText;
    for (ModelElement const& element : elements)
    {
        auto const rank = std::find(std::begin(ORDER), std::end(ORDER), classNameOf(element));
        byText.emplace(std::pair(rank - std::begin(ORDER), textOf<Form>(element, before)), element);
    }
    std::vector<ModelElement> result;
    for (auto const& [key, element] : byText)
        result.push_back(element);
    return result;
}

void printCounts(std::ostream& output, std::string const& verb,
                 std::vector<ModelElement> const& elements)
{
    std::map<std::string, std::size_t> counts;
    for (ModelElement const& element : elements)
        ++counts[classNameOf(element)];
    output << "  " << verb << ' ' << elements.size() << " elements";
    char const* separator = ": ";
    for (auto const& [name, count] : counts)
    {
        output << separator << count << ' ' << name;
        separator = ", ";
    }
    output << '\n';
}

}  // namespace

template <ElementForm Form>
void printReport(std::ostream& output, ReportData const& report, std::size_t maxLines)
{
    std::size_t lines = 0;
    auto const print = [&](std::string const& verb, std::vector<ModelElement> const& elements) {
        for (ModelElement const& element : sorted<Form>(elements, &report))
        {
            if (++lines <= maxLines)
                output << "    " << lineOf<Form>(report, verb, element) << '\n';
        }
    };
    print("changed", report.getChanged());
    print("destroyed", report.getDestroyed());
    if (lines > maxLines)
        output << "    and " << lines - maxLines << " lines more\n";
    printCounts(output, "changed", report.getChanged());
    printCounts(output, "destroyed", report.getDestroyed());
}

#define DEBIAN_INSTANTIATE(Form)                                                                   \
    template void printReport<Form>(std::ostream&, ReportData const&, std::size_t);
DEBIAN_FOR_EACH_FORM(DEBIAN_INSTANTIATE)

}  // namespace debian
