// svy localize: plane localization (site calibration). `fit` finds the similarity (or rigid) transformation
// to = shift + scale * R(rotation) * from from control points known in both systems, the rotation clockwise
// as azimuths turn; `apply` carries points through a given transformation, or back with --inverse.
#include "row_io.h"
#include "verbs.h"

#include "svymath/cogo/localization_2d.h"
#include "svymath/foundation/constants.h"

#include <CLI/CLI.hpp>

#include <iostream>
#include <memory>
#include <string>
#include <vector>

namespace {

using svy_math::units::kDegToRad;
using svy_math::units::kRadToDeg;

// Written decimals: coordinates and residuals to 0.1 mm; the scale to 1e-9 (0.005 mm over 5 km); the
// rotation to 1e-8 degree (0.001 mm at 5 km).
constexpr int kLengthDecimals = 4;
constexpr int kScaleDecimals = 9;
constexpr int kRotationDecimals = 8;

struct ControlRows {
  std::vector<std::string> ids;
  CLocalizationOn2dPlane localization;
};

// Reads id,n_from,e_from,n_to,e_to rows; returns kExitOk, kExitBadRows (a row left out) or kExitUsage.
int readControl(const std::string& path, ControlRows& control) {
  std::string error;
  const std::unique_ptr<std::istream> in = svy_tool::openInput(path, error);
  if (!in) {
    std::cerr << "svy: " << error << '\n';
    return svy_tool::kExitUsage;
  }
  const svy_tool::RowFormat format{{"id", "n_from", "e_from", "n_to", "e_to"}, false, {}};
  svy_tool::RowReader reader(*in, format.inputs, format.numericInput);
  svy_tool::InputRow row;
  int status = svy_tool::kExitOk;
  while (reader.next(row)) {
    double v[4] = {0, 0, 0, 0};
    bool ok = svy_tool::checkRow(format, row, error);
    for (int k = 0; ok && k < 4; ++k) {
      ok = svy_tool::parseNumber(row.fields[k + 1], v[k]);
      if (!ok) error = format.inputs[k + 1] + ": " + svy_tool::quoteForMessage(row.fields[k + 1]) + " is not a number";
    }
    if (!ok) {
      svy_tool::reportBadRow(row.lineNumber, error);
      status = svy_tool::kExitBadRows;
      continue;
    }
    control.localization.addPoint(C2dPos(v[0], v[1]), C2dPos(v[2], v[3]));
    control.ids.push_back(row.fields[0]);
  }
  return status;
}

std::string failureText(ELocalizationStatus status) {
  return status == eLocTooFewPoints ? "at least two control points are needed"
                                    : "the control points coincide: no rotation or scale";
}

void addFit(CLI::App& family) {
  CLI::App* verb = family.add_subcommand(
      "fit", "Similarity transformation from control rows id,n_from,e_from,n_to,e_to");
  const std::shared_ptr<std::string> input = svy_tool::addInputArgument(*verb);
  const std::shared_ptr<bool> rigid = std::make_shared<bool>(false);
  const std::shared_ptr<bool> residuals = std::make_shared<bool>(false);
  verb->add_flag("--rigid", *rigid, "Keep the scale at 1 (rotation and shifts only)");
  verb->add_flag("--residuals", *residuals, "Write each control point's residual (id,dn,de,residual,flag)");
  verb->callback([verb, input, rigid, residuals] {
    ControlRows control;
    int status = readControl(*input, control);
    if (status == svy_tool::kExitUsage) svy_tool::finishVerb(status);
    const ELocalizationStatus fit = control.localization.solve(*rigid);
    const std::vector<svy_tool::Column> columns =
        *residuals ? std::vector<svy_tool::Column>{{"id", 0}, {"dn", kLengthDecimals}, {"de", kLengthDecimals},
                                                   {"residual", kLengthDecimals}, {"flag", 0}}
                   : std::vector<svy_tool::Column>{{"scale", kScaleDecimals}, {"rotation_deg", kRotationDecimals},
                                                   {"shift_n", kLengthDecimals}, {"shift_e", kLengthDecimals},
                                                   {"rms", kLengthDecimals}};
    svy_tool::RowWriter writer(std::cout, columns, svy_tool::outputOptionsFor(*verb));
    if (fit != eLocOk) {
      std::cerr << "svy: " << failureText(fit) << '\n';
      status = svy_tool::kExitBadRows;
    } else if (*residuals) {
      for (int i = 0; i < control.localization.count(); ++i) {
        TLocalizationResidual r;
        control.localization.getResidual(i, r);
        writer.write({control.ids[i], r.dNorth, r.dEast, r.length, std::string(r.outlier ? "outlier" : "")});
      }
    } else {
      const svy_math::TSimilarity2d& t = control.localization.transformation();
      writer.write({t.scale, t.rotation * kRadToDeg, t.shift.north(), t.shift.east(), control.localization.getRms()});
    }
    writer.finish();
    svy_tool::finishVerb(status);
  });
}

void addApply(CLI::App& family) {
  CLI::App* verb = family.add_subcommand("apply", "Carry rows n,e through a similarity transformation");
  const std::shared_ptr<std::string> input = svy_tool::addInputArgument(*verb);
  const std::shared_ptr<svy_math::TSimilarity2d> transform = std::make_shared<svy_math::TSimilarity2d>();
  const std::shared_ptr<double> rotationDeg = std::make_shared<double>(0.0);
  const std::shared_ptr<std::string> shiftText = std::make_shared<std::string>();
  const std::shared_ptr<bool> inverse = std::make_shared<bool>(false);
  svy_tool::requireNumberText(verb->add_option("--scale", transform->scale, "Scale factor"))->required();
  svy_tool::requireNumberText(verb->add_option("--rotation", *rotationDeg, "Rotation, degrees clockwise"))->required();
  verb->add_option("--shift", *shiftText, "Shift N,E (metres)")->required();
  verb->add_flag("--inverse", *inverse, "From the `to` system back to the `from` system");
  verb->callback([verb, input, transform, rotationDeg, shiftText, inverse] {
    std::vector<double> shift;
    if (!svy_tool::parseNumberList(*shiftText, 2, shift))
      throw CLI::ValidationError("--shift: expected N,E, got '" + *shiftText + "'");
    if (*inverse && transform->scale == 0.0) throw CLI::ValidationError("--scale: 0 cannot be inverted");
    transform->rotation = *rotationDeg * kDegToRad;
    transform->shift = C2dPos(shift[0], shift[1]);
    const svy_tool::RowFormat format{{"n", "e"}, true, {{"n", kLengthDecimals}, {"e", kLengthDecimals}}};
    svy_tool::finishVerb(svy_tool::runRows(
        *input, format, svy_tool::outputOptionsFor(*verb),
        [transform, inverse](const svy_tool::InputRow& row, std::vector<svy_tool::Cell>& out, std::string&) {
          const C2dPos p(row.numbers[0], row.numbers[1]);
          C2dPos q = transform->forward(p);
          if (*inverse) transform->inverse(p, q);
          out = {q.north(), q.east()};
          return true;
        }));
  });
}

}  // namespace

void registerLocalizeVerbs(CLI::App& app) {
  CLI::App* family = app.add_subcommand("localize", "Plane localization (site calibration) between two systems");
  family->require_subcommand(1);
  addFit(*family);
  addApply(*family);
}
