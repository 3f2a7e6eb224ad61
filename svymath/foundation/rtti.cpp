#include "svymath/foundation/rtti.h"

const char* CRttiBase::static_rtti_name() { return "CRttiBase"; }
const void* CRttiBase::get_rtti_id() const { return static_rtti_id(); }
const char* CRttiBase::get_rtti_name() const { return static_rtti_name(); }
const void* CRttiBase::find_rtti_type(const void* id) const {
  return id == static_rtti_id() ? static_cast<const CRttiBase*>(this) : nullptr;
}
CRttiBase::~CRttiBase() = default;
