#include "svymath/curves/generic_segment_visitor.h"

CGenericSegmentVisitor::~CGenericSegmentVisitor() = default;
CGenericSegmentVisitor_const::~CGenericSegmentVisitor_const() = default;
