#pragma once
// One registration function per verb family: each adds its family subcommand ("svy cogo ...") and the verbs
// under it to the root command. Every family source reads and writes rows through row_io.h.

namespace CLI {
class App;
}

void registerCogoVerbs(CLI::App& app);
void registerAngleVerbs(CLI::App& app);
void registerStationVerbs(CLI::App& app);
void registerUnitsVerbs(CLI::App& app);
// "svy curve" (circular-curve quantities) and "svy spiral" (transition-spiral tables).
void registerCurveVerbs(CLI::App& app);
// "svy fit": least-squares best-fit line, circle and radius of plane points.
void registerFitVerbs(CLI::App& app);
// "svy geo" (geodetic, earth-centred, local east/north/up) and "svy time" (GPS time).
void registerGeoVerbs(CLI::App& app);
void registerTimeVerbs(CLI::App& app);
// "svy localize": plane localization (site calibration) fit and apply.
void registerLocalizeVerbs(CLI::App& app);
// "svy resect": free-station resection.
void registerResectVerbs(CLI::App& app);
// "svy profile": heights and grades of a profile given by its vertical intersection points.
void registerProfileVerbs(CLI::App& app);
// "svy road": catch points of cut and fill slopes (slope staking).
void registerRoadVerbs(CLI::App& app);
// "svy traverse": adjustment of a traverse between known points (compass and transit rules).
void registerTraverseVerbs(CLI::App& app);
// "svy view": screen positions of targets seen from an observer.
void registerViewVerbs(CLI::App& app);
// "svy area": area and perimeter of a boundary of lines and arcs, and its subdivision by a known area.
void registerAreaVerbs(CLI::App& app);
void registerAlignVerbs(CLI::App& app);
