#pragma once
#include "svyio/landxml_context.h"

namespace svy_io {
namespace detail {

// The <CoordGeom> and <StaEquation> children of an <Alignment> into the horizontal alignment and its station
// equations: each element chained from its predecessor's end, as the library does.
void readHorizontal(CLandXmlContext& context, const pugi::xml_node& alignmentNode, TLandXmlAlignment& alignment);

}  // namespace detail
}  // namespace svy_io
