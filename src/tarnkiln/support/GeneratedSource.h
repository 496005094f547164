/// \file
/// What the sources of generated classes include of the library, to be compiled once for a target.
///
/// No source includes it: `tarnkiln_add_metamodel` makes a precompiled header of it when it is told
/// `PRECOMPILED`.
#pragma once
#include "tarnkiln/collections/ElementMap.h"
#include "tarnkiln/collections/ElementMultimap.h"
#include "tarnkiln/collections/ElementSequence.h"
#include "tarnkiln/collections/PrimitiveSequence.h"
#include "tarnkiln/collections/PrimitiveSet.h"
#include "tarnkiln/collections/UnorderedElementSet.h"
#include "tarnkiln/query/ModelElementConstrainables.h"
#include "tarnkiln/support/BuilderSteps.h"
#include "tarnkiln/support/DispatchSteps.h"
#include "tarnkiln/support/Handle.h"
