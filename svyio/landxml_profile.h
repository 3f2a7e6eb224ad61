#pragma once
#include "svyio/landxml_context.h"

namespace svy_io {
namespace detail {

// The <ProfAlign> design profiles of an alignment's <Profile> elements; ground profiles (<ProfSurf>) are noted.
void readProfiles(CLandXmlContext& context, const pugi::xml_node& alignmentNode, TLandXmlAlignment& alignment);

}  // namespace detail
}  // namespace svy_io
