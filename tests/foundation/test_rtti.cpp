#include <gtest/gtest.h>

#include "svymath/foundation/rtti.h"

// A small hierarchy shaped like the model classes: a public interface and an implementation joined by
// multiple inheritance, both deriving virtually from the root.
namespace rtti_test {

class CShapeBase : public virtual CRttiBase {
  SVY_RTTI_DECLARE(CShapeBase)
};
class CShapeImpl : public virtual CRttiBase {
  SVY_RTTI_DECLARE(CShapeImpl)
  double payload = 1.5;
};
class CCircleShape : public CShapeBase, public CShapeImpl {
  SVY_RTTI_DECLARE(CCircleShape)
};
class CUnrelated : public virtual CRttiBase {
  SVY_RTTI_DECLARE(CUnrelated)
};

SVY_RTTI_DEFINE(CShapeBase, CRttiBase)
SVY_RTTI_DEFINE(CShapeImpl, CRttiBase)
SVY_RTTI_DEFINE2(CCircleShape, CShapeBase, CShapeImpl)
SVY_RTTI_DEFINE(CUnrelated, CRttiBase)

}  // namespace rtti_test

using namespace rtti_test;

// The id is the address of the name literal (an equal string elsewhere is not the id); cast adjusts the
// pointer across both bases and refuses unrelated classes, null, and a base that is not the derived class.
TEST(RunTimeTypeIdentity, IdIsTheNameLiteralAndCastAdjustsAcrossBothBases) {
  static const char copy[] = "CCircleShape";
  EXPECT_EQ(CCircleShape::static_rtti_id(), static_cast<const void*>(CCircleShape::static_rtti_name()));
  EXPECT_NE(static_cast<const void*>(copy), CCircleShape::static_rtti_id());
  EXPECT_NE(CShapeBase::static_rtti_id(), CShapeImpl::static_rtti_id());
  CCircleShape circle;
  CRttiBase* root = static_cast<CShapeBase*>(&circle);
  EXPECT_EQ(root->get_rtti_id(), CCircleShape::static_rtti_id());
  EXPECT_STREQ(root->get_rtti_name(), "CCircleShape");
  EXPECT_EQ(CCircleShape::cast(root), &circle);
  EXPECT_EQ(CShapeBase::cast(root), static_cast<CShapeBase*>(&circle));
  CShapeImpl* impl = CShapeImpl::cast(root);
  ASSERT_EQ(impl, static_cast<CShapeImpl*>(&circle));
  EXPECT_EQ(impl->payload, 1.5);
  EXPECT_EQ(CUnrelated::cast(root), nullptr);
  EXPECT_EQ(CCircleShape::cast(static_cast<CRttiBase*>(nullptr)), nullptr);
  const CRttiBase* constRoot = root;
  EXPECT_EQ(CCircleShape::cast(constRoot), &circle);
  EXPECT_TRUE(constRoot->is_rtti_type(CRttiBase::static_rtti_id()));
  CShapeImpl alone;
  EXPECT_EQ(CCircleShape::cast(&alone), nullptr);
}
