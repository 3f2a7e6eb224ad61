#pragma once
// Road strings: named 3-D lines along a road, each a polyline of vertices (chainage, offset, height) in
// increasing chainage, the offset in metres across the centre line (positive right) and the height an
// absolute elevation (metres). Between vertices offset and height are linear in chainage. A set of strings
// describes a road surface: the section at a chainage joins the strings that cover it, in offset order.
#include "svymath/foundation/class_new.h"
#include "svymath/foundation/export.h"
#include "svymath/foundation/rtti.h"
#include "svymath/road/cross_section.h"
#include "svyutils/svy_containers.h"
#include "svyutils/svy_string.h"

struct TRoadStringVertex {
  double chainage;
  double offset;
  double height;
};

class SVYMATH_API CRoadString : public virtual CRttiBase {
  SVY_RTTI_DECLARE(CRoadString)

 public:
  SVY_CLASS_NEW_DELETE

  explicit CRoadString(const svy_text::CSvyString& name = {}, unsigned featureIndex = 0);
  CRoadString(const CRoadString& other);
  CRoadString& operator=(const CRoadString& other);
  ~CRoadString() override;

  const svy_text::CSvyString& getName() const { return m_name; }
  unsigned getFeatureIndex() const { return m_featureIndex; }
  // Appends a vertex; false when a value is not a finite number or the chainage lies before the last one.
  bool addVertex(double chainage, double offset, double height);
  void removeAllVertices() { m_vertices.clear(); }
  int getNumOfVertices() const { return static_cast<int>(m_vertices.size()); }
  const TRoadStringVertex* getVertex(int index) const;
  // Offset and height at a chainage inside the string's range (its first to last vertex); false outside.
  bool getOffsetAndHeightAtChainage(double chainage, double& offset, double& height) const;

 private:
  svy_text::CSvyString m_name;
  unsigned m_featureIndex;
  svy_vector<TRoadStringVertex> m_vertices;
};

class SVYMATH_API CRoadStringSet : public virtual CRttiBase {
  SVY_RTTI_DECLARE(CRoadStringSet)

 public:
  SVY_CLASS_NEW_DELETE

  CRoadStringSet();
  CRoadStringSet(const CRoadStringSet& other);
  CRoadStringSet& operator=(const CRoadStringSet& other);
  ~CRoadStringSet() override;

  // Adds a copy of a string and returns its index.
  int addString(const CRoadString& roadString);
  void removeAll() { m_strings.clear(); }
  int getNumOfStrings() const { return static_cast<int>(m_strings.size()); }
  const CRoadString* getString(int index) const;
  CRoadString* getString(int index);
  // The first string with a name, or null.
  CRoadString* findString(const svy_text::CSvyString& name);
  // Adds to a section one point per string covering the chainage, at its offset and height, named after the
  // string; false when no string covers it.
  bool fillSection(double chainage, CEditableRoadCrossSection& section) const;

 private:
  svy_vector<CRoadString> m_strings;
};
