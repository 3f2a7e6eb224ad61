// svy area: the area and perimeter of a boundary of lines and arcs, and its subdivision by a known area.
// Rows n,e[,radius,direction] are the boundary's vertices in order; a row with a radius makes the segment
// from its vertex to the next the arc of at most a half turn with that radius, turning cw or ccw. The last
// vertex is joined to the first (a last row repeating the first vertex is dropped).
#include "row_io.h"
#include "verbs.h"

#include "svymath/area/area_support.h"
#include "svymath/area/polygon_area.h"
#include "svymath/area/polygon_predicates.h"
#include "svymath/area/subdivision.h"
#include "svymath/foundation/constants.h"

#include <CLI/CLI.hpp>
#include <nlohmann/json.hpp>

#include <algorithm>
#include <cctype>
#include <iostream>
#include <memory>
#include <string>
#include <vector>

namespace {

// Written decimals: coordinates, lengths and radii to 0.1 mm, areas to 0.0001 m^2.
constexpr int kLengthDecimals = 4;
constexpr int kAreaDecimals = 4;

struct TVertex {
  TCoords at;
  double radius = 0.0;  // 0: a line to the next vertex
  bool counterClockwise = false;
  std::size_t lineNumber = 0;
};

const svy_tool::RowFormat kBoundaryFormat{{"n", "e", "radius", "direction"}, false, {}, 2};

std::string lower(std::string text) {
  std::transform(text.begin(), text.end(), text.begin(),
                 [](unsigned char c) { return static_cast<char>(std::tolower(c)); });
  return text;
}

// Reads one vertex row; false with the message for a bad row.
bool parseVertex(const svy_tool::InputRow& row, TVertex& vertex, std::string& error) {
  if (!svy_tool::parseNumber(row.fields[0], vertex.at.north) || !svy_tool::parseNumber(row.fields[1], vertex.at.east)) {
    error = "n and e must be numbers";
    return false;
  }
  vertex.lineNumber = row.lineNumber;
  const bool hasRadius = row.fields.size() > 2 && !row.fields[2].empty();
  if (!hasRadius) {
    if (row.fields.size() > 3 && !row.fields[3].empty()) error = "a direction needs a radius";
    return error.empty();
  }
  if (!svy_tool::parseNumber(row.fields[2], vertex.radius) || !(vertex.radius > 0.0)) {
    error = "radius: '" + row.fields[2] + "' is not a positive number";
    return false;
  }
  const std::string direction = row.fields.size() > 3 ? lower(row.fields[3]) : std::string();
  if (direction != "cw" && direction != "ccw") {
    error = "direction: expected cw or ccw after a radius";
    return false;
  }
  vertex.counterClockwise = direction == "ccw";
  return true;
}

// Reads the boundary; returns kExitOk, kExitBadRows (bad rows reported and left out) or kExitUsage.
int readBoundary(const std::string& path, std::vector<TVertex>& vertices) {
  std::string error;
  const std::unique_ptr<std::istream> in = svy_tool::openInput(path, error);
  if (!in) {
    std::cerr << "svy: " << error << '\n';
    return svy_tool::kExitUsage;
  }
  svy_tool::RowReader reader(*in, kBoundaryFormat.inputs, kBoundaryFormat.numericInput);
  svy_tool::InputRow row;
  int status = svy_tool::kExitOk;
  while (reader.next(row)) {
    TVertex vertex;
    error.clear();
    if (!svy_tool::checkRow(kBoundaryFormat, row, error) || !parseVertex(row, vertex, error)) {
      svy_tool::reportBadRow(row.lineNumber, error);
      status = svy_tool::kExitBadRows;
      continue;
    }
    vertices.push_back(vertex);
  }
  if (vertices.size() > 1 && boAreSameAreaVertex(vertices.back().at, vertices.front().at)) vertices.pop_back();
  return status;
}

// The boundary's segments; false with a message when an arc does not fit between its vertices.
bool buildBoundary(const std::vector<TVertex>& vertices, svy_list<AreaSegment>& list, std::string& error) {
  for (std::size_t i = 0; i < vertices.size(); ++i) {
    const TVertex& v = vertices[i];
    const TCoords& next = vertices[(i + 1) % vertices.size()].at;
    if (v.radius == 0.0) {
      list.emplace_back(v.at, next);
      continue;
    }
    TCoords centre;
    if (!boComputeCenterPointCoords(v.at, next, v.radius, v.counterClockwise, centre)) {
      error = "line " + std::to_string(v.lineNumber) + ": no arc of radius " +
              svy_tool::formatNumber(v.radius, kLengthDecimals) +
              " reaches the next vertex";
      return false;
    }
    list.emplace_back(v.at, next, centre, v.counterClockwise);
  }
  return true;
}

std::string crossingText(EAreaCalcStatus status) {
  switch (status) {
    case eAreaCalcSegmentsCross: return "the boundary crosses itself";
    case eAreaCalcChordCrosses: return "the chord of an arc crosses the boundary";
    case eAreaCalcTooFewSegments: return "a boundary needs three vertices, or two with an arc";
    case eAreaCalcZeroArea: return "the boundary encloses no area";
    case eAreaCalcNotACircle: return "a single arc must be a whole circle";
    case eAreaCalcTotalAreaFailed: return "the boundary's area cannot be computed";
    case eAreaCalcAreaTooLarge: return "the requested area exceeds the boundary's area";
    case eAreaCalcSearchFailed: return "no cut gives the requested area";
    default: return "the boundary's geometry failed";
  }
}

// Reads and checks the boundary; on failure reports it and returns the exit status, else kExitOk with the
// read status in readStatus.
int loadBoundary(const std::string& path, svy_list<AreaSegment>& list, int& readStatus) {
  std::vector<TVertex> vertices;
  readStatus = readBoundary(path, vertices);
  if (readStatus == svy_tool::kExitUsage) return readStatus;
  std::string error;
  const bool anyArc = std::any_of(vertices.begin(), vertices.end(), [](const TVertex& v) { return v.radius > 0.0; });
  if (vertices.size() < 2 || (vertices.size() == 2 && !anyArc)) error = crossingText(eAreaCalcTooFewSegments);
  if (error.empty()) buildBoundary(vertices, list, error);
  const EAreaCalcStatus crossing = error.empty() ? eDoAreaSegmentsCross(list, false) : eAreaCalcOk;
  if (crossing != eAreaCalcOk) error = crossingText(crossing);
  if (error.empty()) return svy_tool::kExitOk;
  std::cerr << "svy: " << error << '\n';
  return svy_tool::kExitBadRows;
}

// The vertices of a piece as rows n,e,radius,direction (the input's form) with the piece's name and area.
void writePieceRows(svy_tool::RowWriter& writer, const std::string& name, double area,
                    const svy_list<AreaSegment>& piece) {
  int index = 1;
  for (const AreaSegment& s : piece) {
    std::vector<svy_tool::Cell> cells{name, area, static_cast<double>(index++), s.start.north, s.start.east};
    if (s.boIsArc()) {
      cells.insert(cells.end(), {s.radius(), std::string(s.counterClockwise ? "ccw" : "cw")});
    } else {
      cells.insert(cells.end(), {std::string(), std::string()});
    }
    writer.write(cells);
  }
}

nlohmann::ordered_json pieceJson(double area, const svy_list<AreaSegment>& piece, const svy_tool::OutputOptions& o) {
  nlohmann::ordered_json vertices = nlohmann::ordered_json::array();
  nlohmann::ordered_json arcs = nlohmann::ordered_json::array();
  for (const AreaSegment& s : piece) {
    if (s.boIsArc())
      arcs.push_back({{"from", vertices.size()},
                      {"radius", svy_tool::shownValue(s.radius(), kLengthDecimals, o)},
                      {"direction", s.counterClockwise ? "ccw" : "cw"}});
    vertices.push_back({svy_tool::shownValue(s.start.north, kLengthDecimals, o),
                        svy_tool::shownValue(s.start.east, kLengthDecimals, o)});
  }
  nlohmann::ordered_json json{{"area", svy_tool::shownValue(area, kAreaDecimals, o)}, {"vertices", vertices}};
  if (!arcs.empty()) json["arcs"] = arcs;
  return json;
}

void writeSubdivision(const svy_tool::OutputOptions& options, const TCoords& cut1, const TCoords& cut2,
                      const svy_list<AreaSegment>& piece, const svy_list<AreaSegment>& rest) {
  double pieceArea = 0.0;
  double restArea = 0.0;
  svy_list<AreaSegment> copy = piece;
  eComputePolygonArea(copy, &pieceArea);
  copy = rest;
  if (eComputePolygonArea(copy, &restArea) != eAreaCalcOk) restArea = 0.0;  // nothing left over
  if (options.json) {
    const auto point = [&](const TCoords& p) {
      return nlohmann::ordered_json{svy_tool::shownValue(p.north, kLengthDecimals, options),
                                    svy_tool::shownValue(p.east, kLengthDecimals, options)};
    };
    const nlohmann::ordered_json document{{"cut", {point(cut1), point(cut2)}},
                                          {"piece", pieceJson(pieceArea, piece, options)},
                                          {"rest", pieceJson(restArea, rest, options)}};
    std::cout << document.dump() << '\n';
    return;
  }
  svy_tool::RowWriter writer(std::cout,
                             {{"part", 0}, {"area", kAreaDecimals}, {"vertex", 0}, {"n", kLengthDecimals},
                              {"e", kLengthDecimals}, {"radius", kLengthDecimals}, {"direction", 0}},
                             options);
  int index = 1;
  for (const TCoords* p : {&cut1, &cut2})
    writer.write({std::string("cut"), std::string(), static_cast<double>(index++), p->north, p->east, std::string(),
                  std::string()});
  writePieceRows(writer, "piece", pieceArea, piece);
  writePieceRows(writer, "rest", restArea, rest);
  writer.finish();
}

void addSubdivide(CLI::App& family) {
  CLI::App* verb = family.add_subcommand(
      "subdivide", "Cut a piece of known area off the boundary, parallel to an azimuth or through a hinge point");
  const std::shared_ptr<std::string> input = svy_tool::addInputArgument(*verb);
  auto area = std::make_shared<double>(0.0);
  auto azimuthDeg = std::make_shared<double>(0.0);
  auto side = std::make_shared<std::string>("left");
  auto hingeText = std::make_shared<std::string>();
  verb->add_option("--area", *area, "Area of the piece (square metres)")->required();
  CLI::Option* parallel = verb->add_option("--parallel", *azimuthDeg, "Azimuth of the cut (degrees from north)");
  verb->add_option("--side", *side, "Side of the cut's direction the piece lies on")
      ->check(CLI::IsMember({"left", "right"}))
      ->needs(parallel);
  CLI::Option* hinge = verb->add_option("--hinge", *hingeText, "Hinge point N,E on the boundary: the cut runs from it");
  parallel->excludes(hinge);
  verb->callback([verb, input, area, azimuthDeg, side, hingeText, parallel] {
    std::vector<double> hingeNe;
    const bool byHinge = parallel->count() == 0;
    if (byHinge && !svy_tool::parseNumberList(*hingeText, 2, hingeNe))
      throw CLI::ValidationError("give --parallel AZ_DEG or --hinge N,E");
    if (!(*area >= 0.0)) throw CLI::ValidationError("--area: expected a non-negative area");
    svy_list<AreaSegment> boundary;
    int readStatus = svy_tool::kExitOk;
    const int status = loadBoundary(*input, boundary, readStatus);
    if (status != svy_tool::kExitOk) svy_tool::finishVerb(status);
    svy_list<AreaSegment> piece;
    svy_list<AreaSegment> rest;
    TCoords cut1;
    TCoords cut2;
    EAreaCalcStatus result = eAreaCalcOk;
    if (byHinge) {
      TCoords at;
      at.north = hingeNe[0];
      at.east = hingeNe[1];
      TCoords noDirection;
      noDirection.mask = 0;
      cut1 = at;
      result = eSubdivideSegmentList(at, noDirection, *area, boundary, &piece, &rest, &cut2);
      if (result == eAreaCalcGeometryFailed) {
        std::cerr << "svy: the hinge point is not on the boundary\n";
        svy_tool::finishVerb(svy_tool::kExitBadRows);
      }
      if (result == eAreaCalcSubdivided) cut1 = piece.front().start;
    } else {
      result = eSubdivideSegmentList(*azimuthDeg * svy_math::units::kDegToRad, *area, *side == "left", boundary,
                                     &piece, &rest, &cut1, &cut2);
    }
    if (result != eAreaCalcSubdivided) {
      std::cerr << "svy: " << crossingText(result) << '\n';
      svy_tool::finishVerb(svy_tool::kExitBadRows);
    }
    writeSubdivision(svy_tool::outputOptionsFor(*verb), cut1, cut2, piece, rest);
    svy_tool::finishVerb(readStatus);
  });
}

}  // namespace

void registerAreaVerbs(CLI::App& app) {
  CLI::App* family = app.add_subcommand(
      "area", "Area and perimeter of a boundary: rows n,e[,radius,cw|ccw] (a radius makes the side to the next "
              "vertex an arc)");
  family->require_subcommand(0, 1);
  const std::shared_ptr<std::string> input = svy_tool::addInputArgument(*family);
  addSubdivide(*family);
  family->callback([family, input] {
    if (family->got_subcommand("subdivide")) return;
    svy_list<AreaSegment> boundary;
    int readStatus = svy_tool::kExitOk;
    const int status = loadBoundary(*input, boundary, readStatus);
    svy_tool::RowWriter writer(std::cout, {{"area", kAreaDecimals}, {"perimeter", kLengthDecimals}},
                               svy_tool::outputOptionsFor(*family));
    if (status != svy_tool::kExitOk) {
      writer.finish();
      svy_tool::finishVerb(status);
    }
    double perimeter = 0.0;
    double area = 0.0;
    boComputePolygonPerimeter(boundary, perimeter);
    const EAreaCalcStatus result = eComputePolygonArea(boundary, &area);
    if (result != eAreaCalcOk) {
      std::cerr << "svy: " << crossingText(result) << '\n';
      writer.finish();
      svy_tool::finishVerb(svy_tool::kExitBadRows);
    }
    writer.write({area, perimeter});
    writer.finish();
    svy_tool::finishVerb(readStatus);
  });
}
