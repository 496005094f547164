#include "tests/stress/DrawnMetamodel.h"

#include <algorithm>

namespace testkit {

// ---------------------------------------------------------------------------- the metamodel

DrawnMetamodel DrawnMetamodel::draw(std::mt19937& random)
{
    auto const below = [&](int count) {
        return static_cast<int>(random() % static_cast<unsigned>(count));
    };
    DrawnMetamodel drawn;
    int const classes = 1 + below(5);
    for (int number = 0; number < classes; ++number)
        drawn.superclasses.push_back(below(number + 1) - 1);

    for (int round = 2 + below(6); round > 0; --round)
    {
        Property end{.owner = below(classes), .target = below(classes)};
        Property otherEnd{.owner = end.target, .target = end.owner};
        switch (below(10))
        {
        case 0:
            drawn.add({.owner = end.owner});
            break;
        case 1:
            drawn.add({.owner = end.owner, .many = true, .ordered = true});
            break;
        case 2:  // one way, at most one
            drawn.add(end);
            break;
        case 3:  // one way, a sequence with repetitions or a set
            end.many = true;
            end.ordered = below(2) == 0;
            end.unique = !end.ordered;
            drawn.add(end);
            break;
        case 4:  // one to one
            drawn.addAssociation(end, otherEnd);
            break;
        case 5:  // many to one
            end.many = end.unique = true;
            end.ordered = below(2) == 0;
            drawn.addAssociation(end, otherEnd);
            break;
        case 6:  // many to many
            end.many = end.unique = otherEnd.many = otherEnd.unique = true;
            end.ordered = otherEnd.ordered = below(2) == 0;
            drawn.addAssociation(end, otherEnd);
            break;
        case 7:  // one part, which may know its whole
            end.composite = true;
            if (below(2) == 0)
                drawn.add(end);
            else
                drawn.addAssociation(end, otherEnd);
            break;
        default:  // many parts, which may know their whole
            end.composite = end.many = end.unique = true;
            end.ordered = below(2) == 0;
            if (below(2) == 0)
                drawn.add(end);
            else
                drawn.addAssociation(end, otherEnd);
            break;
        }
    }
    return drawn;
}

bool DrawnMetamodel::isA(int subclass, int superclass) const
{
    while (subclass != NONE && subclass != superclass)
        subclass = superclasses[static_cast<std::size_t>(subclass)];
    return subclass == superclass;
}

int DrawnMetamodel::add(Property const& property)
{
    properties.push_back(property);
    return static_cast<int>(properties.size()) - 1;
}

void DrawnMetamodel::addAssociation(Property end, Property otherEnd)
{
    int const first = static_cast<int>(properties.size());
    end.opposite = first + 1;
    otherEnd.opposite = first;
    add(end);
    add(otherEnd);
}

// ---------------------------------------------------------------------------- elements

std::vector<int> ElementMirror::valuesOf(int element, int property) const
{
    auto const& values = m_elements.at(element).values;
    auto const found = values.find(property);
    return found == values.end() ? std::vector<int>() : found->second;
}

void ElementMirror::setNumber(int element, int property, int number)
{
    m_elements.at(element).values[property] = {number};
}

void ElementMirror::addNumber(int element, int property, int number)
{
    m_elements.at(element).values[property].push_back(number);
}

bool ElementMirror::set(int element, int property, int target)
{
    DrawnMetamodel::Property const& end = m_metamodel->at(property);
    std::vector<int> const old = valuesOf(element, property);
    if (target == NONE)
    {
        if (!old.empty())
            remove(element, property, old.front());
        return true;
    }
    if (holds(element, property, target))
        return true;
    if (end.composite && isInside(element, target))
        return false;
    // the other end of contents decides like the end itself
    if (end.opposite != NONE && m_metamodel->at(end.opposite).composite)
    {
        return m_metamodel->at(end.opposite).many ? add(target, end.opposite, element)
                                                  : set(target, end.opposite, element);
    }
    if (!old.empty())
        remove(element, property, old.front());
    link(element, property, target);
    return true;
}

bool ElementMirror::add(int element, int property, int target)
{
    DrawnMetamodel::Property const& end = m_metamodel->at(property);
    if (end.composite && isInside(element, target))
        return false;
    if (!end.unique || !holds(element, property, target))
        link(element, property, target);
    return true;
}

void ElementMirror::remove(int element, int property, int target)
{
    if (!holds(element, property, target))
        return;
    DrawnMetamodel::Property const& end = m_metamodel->at(property);
    if (end.composite)
        leaveContainer(target);
    else if (end.opposite != NONE && m_metamodel->at(end.opposite).composite)
        leaveContainer(element);
    else
        unlink(element, property, target);
}

void ElementMirror::destroy(int element)
{
    leaveContainer(element);
    forget(element);
}

bool ElementMirror::isInside(int element, int outer) const
{
    while (element != NONE && element != outer)
        element = m_elements.at(element).container;
    return element == outer;
}

bool ElementMirror::holds(int element, int property, int target) const
{
    std::vector<int> const values = valuesOf(element, property);
    return std::find(values.begin(), values.end(), target) != values.end();
}

/// Into both ends; an end that holds one only lets the former go.
void ElementMirror::link(int element, int property, int target)
{
    DrawnMetamodel::Property const& end = m_metamodel->at(property);
    if (end.composite)
        leaveContainer(target);
    if (end.opposite != NONE && !m_metamodel->at(end.opposite).many)
    {
        for (int const former : valuesOf(target, end.opposite))
            unlink(target, end.opposite, former);
    }
    m_elements.at(element).values[property].push_back(target);
    if (end.opposite != NONE)
        m_elements.at(target).values[end.opposite].push_back(element);
    if (end.composite)
    {
        m_elements.at(target).container = element;
        m_elements.at(target).place = property;
    }
}

void ElementMirror::unlink(int element, int property, int target)
{
    auto const eraseFirst = [&](int holder, int place, int value) {
        std::vector<int>& values = m_elements.at(holder).values[place];
        auto const found = std::find(values.begin(), values.end(), value);
        if (found != values.end())
            values.erase(found);
    };
    eraseFirst(element, property, target);
    int const opposite = m_metamodel->at(property).opposite;
    if (opposite != NONE && isAlive(target))
        eraseFirst(target, opposite, element);
}

void ElementMirror::leaveContainer(int element)
{
    Element& part = m_elements.at(element);
    if (part.container == NONE)
        return;
    unlink(part.container, part.place, element);
    part.container = part.place = NONE;
}

void ElementMirror::forget(int element)
{
    Element const gone = m_elements.at(element);
    for (auto const& [property, values] : gone.values)
    {
        for (int const value : values)
        {
            if (m_metamodel->isAttribute(property) || !isAlive(value))
                continue;
            if (m_metamodel->at(property).composite)
                forget(value);
            else if (m_metamodel->at(property).opposite != NONE)
                unlink(element, property, value);
        }
    }
    m_elements.erase(element);
}
}  // namespace testkit
