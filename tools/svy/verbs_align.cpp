// svy align: the surveyor's work along a LandXML road. `station` gives each surveyed point its station,
// offset, design height and cut or fill; `info` lists the road's elements and profile points.
#include "landxml_input.h"
#include "row_io.h"
#include "verbs.h"

#include <CLI/CLI.hpp>

#include <algorithm>
#include <cctype>
#include <cmath>
#include <iostream>
#include <limits>
#include <memory>
#include <string>
#include <vector>

#include "svymath/alignments/chainage_iterator.h"
#include "svymath/alignments/horz_element_spiral.h"
#include "svymath/alignments/vertical_element_base.h"

namespace {

using svy_tool::Cell;
using svy_tool::Column;

// Written decimals: plan lengths and heights to the millimetre, spiral parameters to the millimetre.
constexpr int kLengthDecimals = 3;
// Azimuths in decimal degrees to 0.0001 degree (0.36 seconds).
constexpr int kAzimuthDecimals = 4;
// Rows read and queried together: the batch query then takes the alignment's lock once per block.
constexpr std::size_t kBlockRows = 4096;
// Inputs longer than this report their progress on stderr, every this many rows.
constexpr std::size_t kProgressRows = 100000;

constexpr double kNaN = std::numeric_limits<double>::quiet_NaN();

const svy_tool::RowFormat kStationFormat{
    {"id", "n", "e", "h"},
    false,
    {{"id", 0}, {"station", kLengthDecimals}, {"station_text", 0}, {"offset", kLengthDecimals},
     {"design_h", kLengthDecimals}, {"cut_fill", kLengthDecimals}, {"extrapolated", 0}},
    3};

struct PendingPoint {
  std::string id;
  double north = 0.0;
  double east = 0.0;
  double height = kNaN;  // NaN: no surveyed height
};

// Parses n, e and the optional h of a checked row.
bool parsePoint(const svy_tool::InputRow& row, PendingPoint& point, std::string& error) {
  point.id = row.fields[0];
  point.height = kNaN;
  if (!svy_tool::parseNumber(row.fields[1], point.north) || !svy_tool::parseNumber(row.fields[2], point.east)) {
    error = "n and e must be numbers";
    return false;
  }
  if (row.fields.size() > 3 && !row.fields[3].empty() && !svy_tool::parseNumber(row.fields[3], point.height)) {
    error = "h must be a number or empty";
    return false;
  }
  return true;
}

bool isColumnName(const std::string& field, const char* name) {
  return field.size() == 1 && std::tolower(static_cast<unsigned char>(field[0])) == name[0];
}

class StationBlock {
 public:
  explicit StationBlock(const svy_tool::LandXmlRoad& road) : road_(road) {}

  void add(const PendingPoint& point) {
    points_.push_back(point);
    north_.push_back(point.north);
    east_.push_back(point.east);
  }
  std::size_t size() const { return points_.size(); }

  // Queries the block through the batch query and writes its rows in input order.
  void flush(svy_tool::RowWriter& writer) {
    results_.resize(points_.size());
    road_.pair.FindChainagesAndOffsets(north_.data(), east_.data(), points_.size(), results_.data(), true);
    for (std::size_t i = 0; i < points_.size(); ++i) writer.write(row(points_[i], results_[i]));
    points_.clear();
    north_.clear();
    east_.clear();
  }

 private:
  std::vector<Cell> row(const PendingPoint& point, const TAlntStationResult& result) const {
    if (!result.found) return {point.id, kNaN, std::string(), kNaN, kNaN, std::string(), std::string()};
    double design = kNaN;
    if (road_.hasProfile && !road_.pair.getPosHAtChainExtr(result.chainage, design)) design = kNaN;
    const Cell cutFill = std::isnan(point.height) ? Cell(std::string()) : Cell(point.height - design);
    return {point.id,   result.chainage, svy_tool::stationText(road_.equations, result.chainage),
            result.offset, design,       cutFill,
            std::string(result.extrapolated ? "yes" : "no")};
  }

  const svy_tool::LandXmlRoad& road_;
  std::vector<PendingPoint> points_;
  std::vector<double> north_;
  std::vector<double> east_;
  std::vector<TAlntStationResult> results_;
};

int runStation(const svy_tool::LandXmlRoad& road, const std::string& inputPath,
               const svy_tool::OutputOptions& options) {
  std::string error;
  const std::unique_ptr<std::istream> in = svy_tool::openInput(inputPath, error);
  if (!in) throw CLI::ValidationError(error);
  svy_tool::RowReader reader(*in, kStationFormat.inputs, false);
  svy_tool::RowWriter writer(std::cout, kStationFormat.outputs, options);
  StationBlock block(road);
  svy_tool::InputRow row;
  std::size_t rows = 0;
  bool bad = false;
  while (reader.next(row)) {
    // A header naming only the required columns (id,n,e without h) is a header too.
    if (rows == 0 && !bad && row.fields.size() >= 3 && isColumnName(row.fields[1], "n") &&
        isColumnName(row.fields[2], "e")) {
      continue;
    }
    PendingPoint point;
    if (!svy_tool::checkRow(kStationFormat, row, error) || !parsePoint(row, point, error)) {
      svy_tool::reportBadRow(row.lineNumber, error);
      bad = true;
      continue;
    }
    block.add(point);
    if (block.size() == kBlockRows) block.flush(writer);
    if (++rows % kProgressRows == 0) std::cerr << "svy: " << rows << " points\n";
  }
  block.flush(writer);
  writer.finish();
  return bad ? svy_tool::kExitBadRows : svy_tool::kExitOk;
}

void addStation(CLI::App& family) {
  CLI::App* verb = family.add_subcommand(
      "station", "Station, offset, design height and cut/fill of surveyed points id,n,e[,h] along a LandXML road");
  const auto landxml = svy_tool::addLandXmlOptions(*verb);
  const std::shared_ptr<std::string> input = svy_tool::addInputArgument(*verb);
  verb->callback([verb, landxml, input] {
    const std::unique_ptr<svy_tool::LandXmlRoad> road = svy_tool::loadLandXmlRoad(*landxml);
    svy_tool::finishVerb(runStation(*road, *input, svy_tool::outputOptionsFor(*verb)));
  });
}

// Signed radius (positive turning right) where the curvature is k; infinity on a tangent.
double radiusOf(double curvature) {
  return curvature == 0.0 ? std::numeric_limits<double>::infinity() : 1.0 / curvature;
}

std::string elementKind(const CAlntHe& element) {
  switch (element.getType()) {
    case eAlntHeSegment:
      return "line";
    case eAlntHeArc:
      return "arc";
    default:
      break;
  }
  const CAlntHeSpiral* spiral = CAlntHeSpiral::cast(const_cast<CAlntHe*>(&element));
  if (spiral == nullptr) return "other";
  return spiral->get_data().getCurve().getSpiralMathType() == eMathSpiralCubic ? "cubic" : "clothoid";
}

const std::vector<Column> kInfoColumns{{"item", 0},
                                       {"station", kLengthDecimals},
                                       {"station_text", 0},
                                       {"length", kLengthDecimals},
                                       {"radius_start", kLengthDecimals},
                                       {"radius_end", kLengthDecimals},
                                       {"spiral_a", kLengthDecimals},
                                       {"height", kLengthDecimals}};

void writeInfo(const svy_tool::LandXmlRoad& road, svy_tool::RowWriter& writer) {
  const CAlntH& plan = road.pair;
  for (int i = 0; i < plan.getNumOfHes(); ++i) {
    const CAlntHe& element = *plan.getHe(i);
    double start = kNaN, length = kNaN, k1 = 0.0, k2 = 0.0;
    element.getStartChainageInM(start);
    element.getHLengthInM(length);
    element.getCurvatureAtLength(0.0, k1);
    element.getCurvatureAtLength(length, k2);
    const CAlntHeSpiral* spiral = CAlntHeSpiral::cast(const_cast<CAlntHe*>(&element));
    const double a = spiral != nullptr ? spiral->get_data().getSpiralParam() : kNaN;
    writer.write({elementKind(element), start, svy_tool::stationText(road.equations, start), length, radiusOf(k1),
                  radiusOf(k2), a, kNaN});
  }
  double end = kNaN, total = kNaN;
  plan.CAlntH::getFinalChainageInM(end);
  plan.getHLengthInM(total);
  writer.write({std::string("end"), end, svy_tool::stationText(road.equations, end), total, kNaN, kNaN, kNaN, kNaN});
  const CAlntV& profile = road.pair.getAlntVes();
  for (int i = 0; road.hasProfile && i < profile.getNumOfVes(); ++i) {
    CLsInfo point;
    if (i == 0) {
      writer.write({std::string("vip"), profile.getStartChainageInM(),
                    svy_tool::stationText(road.equations, profile.getStartChainageInM()), 0.0, kNaN, kNaN, kNaN,
                    profile.getStartPosH()});
    }
    const CAlntVe& element = *profile.getVe(i);
    if (element.getStartGrade() != element.getEndGrade() && element.getAsLs(point)) {
      writer.write({std::string("vip"), point.ipChainage, svy_tool::stationText(road.equations, point.ipChainage),
                    point.curveLength, point.radius == 0.0 ? kNaN : point.radius, kNaN, kNaN, point.ipHeight});
    }
  }
  double last = kNaN, lastHeight = kNaN;
  if (road.hasProfile && profile.getFinalChainageInM(last) && profile.getFinalHeight(lastHeight)) {
    writer.write({std::string("vip"), last, svy_tool::stationText(road.equations, last), 0.0, kNaN, kNaN, kNaN,
                  lastHeight});
  }
  writer.finish();
}

void addInfo(CLI::App& family) {
  CLI::App* verb = family.add_subcommand(
      "info", "Elements of a LandXML road (start station, length, radii, spiral parameter), its end and profile points");
  const auto landxml = svy_tool::addLandXmlOptions(*verb);
  verb->callback([verb, landxml] {
    const std::unique_ptr<svy_tool::LandXmlRoad> road = svy_tool::loadLandXmlRoad(*landxml);
    svy_tool::RowWriter writer(std::cout, kInfoColumns, svy_tool::outputOptionsFor(*verb));
    writeInfo(*road, writer);
  });
}

struct StakeoutOptions {
  double from = kNaN;
  double to = kNaN;
  double interval = kNaN;
  std::string offsets = "0";
};

const std::vector<Column> kStakeoutColumns{{"station", kLengthDecimals}, {"offset", kLengthDecimals},
                                           {"n", kLengthDecimals},       {"e", kLengthDecimals},
                                           {"h", kLengthDecimals},       {"azimuth_deg", kAzimuthDecimals}};

std::vector<double> parseOffsets(const std::string& text) {
  std::vector<double> offsets;
  std::size_t begin = 0;
  while (begin <= text.size()) {
    const std::size_t end = std::min(text.find(',', begin), text.size());
    double value = 0.0;
    if (!svy_tool::parseNumber(text.substr(begin, end - begin), value)) {
      throw CLI::ValidationError("--offsets: expected numbers separated by commas, got '" + text + "'");
    }
    offsets.push_back(value);
    begin = end + 1;
  }
  return offsets;
}

// The setting-out points: every station of the chainage iterator (multiples of the interval, element
// starts and ends, vertical curve ends, high and low points) at every offset.
void writeStakeout(svy_tool::LandXmlRoad& road, const StakeoutOptions& options, svy_tool::RowWriter& writer) {
  if (!(options.interval > 0.0) || !(options.to >= options.from)) {
    throw CLI::ValidationError("--interval must be positive and --to not before --from");
  }
  const std::vector<double> offsets = parseOffsets(options.offsets);
  road.pair.setChainageIntervalInM(options.interval);
  const CChainageIteratorBase stations(road.pair, options.from, options.to);
  for (const TChainagePoint& point : stations.getPoints()) {
    double azimuth = kNaN, height = kNaN;
    if (!road.pair.getAzimuthAtChain(point.chainage, azimuth)) azimuth = kNaN;
    if (!road.hasProfile || !road.pair.getPosHAtChain(point.chainage, height)) height = kNaN;
    for (const double offset : offsets) {
      double north = kNaN, east = kNaN;
      if (!road.pair.getPosAtChainAndOffset(point.chainage, offset, north, east)) north = east = kNaN;
      writer.write({point.chainage, offset, north, east, height, azimuth});
    }
  }
  writer.finish();
}

void addStakeout(CLI::App& family) {
  CLI::App* verb = family.add_subcommand(
      "stakeout", "Setting-out table station,offset,n,e,h,azimuth_deg along a LandXML road");
  const auto landxml = svy_tool::addLandXmlOptions(*verb);
  const auto options = std::make_shared<StakeoutOptions>();
  verb->add_option("--from", options->from, "First chainage (metres)")->required();
  verb->add_option("--to", options->to, "Last chainage (metres)")->required();
  verb->add_option("--interval", options->interval, "Station interval (metres)")->required();
  verb->add_option("--offsets", options->offsets, "Offsets, positive right (metres, comma separated; default 0)");
  verb->callback([verb, landxml, options] {
    const std::unique_ptr<svy_tool::LandXmlRoad> road = svy_tool::loadLandXmlRoad(*landxml);
    svy_tool::RowWriter writer(std::cout, kStakeoutColumns, svy_tool::outputOptionsFor(*verb));
    writeStakeout(*road, *options, writer);
  });
}

}  // namespace

void registerAlignVerbs(CLI::App& app) {
  CLI::App* family = app.add_subcommand("align", "Work along a road alignment read from LandXML");
  family->require_subcommand(1);
  addStation(*family);
  addInfo(*family);
  addStakeout(*family);
}
