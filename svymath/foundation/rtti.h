#pragma once
// Run-time type identity of the model classes. Each class names itself with a literal; the identity of a
// class is the address of that literal (one definition in one source file, so one address in the process),
// which makes a type test a pointer comparison instead of a string comparison. find_rtti_type answers with
// the object itself, seen as the class asked for (so the pointer is already adjusted for multiple and
// virtual inheritance), or null when the object is not of that class.
//
// Use: in the class body   SVY_RTTI_DECLARE(CMyClass)
//      in its source file  SVY_RTTI_DEFINE(CMyClass, CMyBase)            (one base)
//                          SVY_RTTI_DEFINE2(CMyClass, CBaseA, CBaseB)    (two bases)
// Every model class derives, directly or through its bases, virtually from CRttiBase.
#include "svymath/foundation/export.h"

class SVYMATH_API CRttiBase {
 public:
  static const char* static_rtti_name();
  static const void* static_rtti_id() { return static_rtti_name(); }
  virtual const void* get_rtti_id() const;
  virtual const char* get_rtti_name() const;

 protected:
  // This object as the class whose identity is id, when it is one; otherwise its base(s) are asked, and the
  // root answers null.
  virtual const void* find_rtti_type(const void* id) const;

 public:
  virtual ~CRttiBase();

  // Whether this object is of the class whose identity is id, or derives from it.
  bool is_rtti_type(const void* id) const { return find_rtti_type(id) != nullptr; }
  // The object seen as the class whose identity is id, or null (what the classes' cast builds on).
  const void* query_rtti_type(const void* id) const { return find_rtti_type(id); }
};

#define SVY_RTTI_DECLARE(ClassName)                                   \
 public:                                                              \
  static const char* static_rtti_name();                              \
  static const void* static_rtti_id() { return static_rtti_name(); }  \
  const void* get_rtti_id() const override;                           \
  const char* get_rtti_name() const override;                         \
  static ClassName* cast(CRttiBase* object);                          \
  static const ClassName* cast(const CRttiBase* object);              \
                                                                      \
 protected:                                                           \
  const void* find_rtti_type(const void* id) const override;          \
                                                                      \
 public:

#define SVY_RTTI_DEFINE_COMMON_(ClassName)                                                           \
  const char* ClassName::static_rtti_name() { return #ClassName; }                                   \
  const void* ClassName::get_rtti_id() const { return static_rtti_id(); }                            \
  const char* ClassName::get_rtti_name() const { return static_rtti_name(); }                        \
  ClassName* ClassName::cast(CRttiBase* object) {                                                    \
    return object == nullptr                                                                         \
               ? nullptr                                                                             \
               : static_cast<ClassName*>(const_cast<void*>(object->query_rtti_type(static_rtti_id()))); \
  }                                                                                                  \
  const ClassName* ClassName::cast(const CRttiBase* object) {                                        \
    return object == nullptr ? nullptr                                                               \
                             : static_cast<const ClassName*>(object->query_rtti_type(static_rtti_id())); \
  }

#define SVY_RTTI_DEFINE(ClassName, BaseName)                                  \
  SVY_RTTI_DEFINE_COMMON_(ClassName)                                          \
  const void* ClassName::find_rtti_type(const void* id) const {               \
    return id == static_rtti_id() ? static_cast<const ClassName*>(this) : BaseName::find_rtti_type(id); \
  }

#define SVY_RTTI_DEFINE2(ClassName, BaseA, BaseB)                                                   \
  SVY_RTTI_DEFINE_COMMON_(ClassName)                                                                \
  const void* ClassName::find_rtti_type(const void* id) const {                                     \
    if (id == static_rtti_id()) return static_cast<const ClassName*>(this);                          \
    const void* asA = BaseA::find_rtti_type(id);                                                     \
    return asA != nullptr ? asA : BaseB::find_rtti_type(id);                                         \
  }
