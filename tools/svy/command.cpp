#include "command.h"

#include "row_io.h"
#include "verbs.h"

#include <CLI/CLI.hpp>

#include <exception>
#include <iostream>

namespace svy_tool {

int runCommand(int argc, const char* const* argv) {
  try {
    CLI::App app{"svy: surveying computations on rows of CSV (file argument or standard input)", "svy"};
    app.require_subcommand(1);
    // Global options are accepted after the verb too: "svy cogo inverse --json points.csv".
    app.fallthrough();
    app.add_flag("--json", "Write a JSON array of objects instead of CSV");
    app.add_flag("--full-precision", "Write numbers with 17 significant digits (they read back exactly)");

    registerCogoVerbs(app);
    registerAngleVerbs(app);
    registerStationVerbs(app);
    registerUnitsVerbs(app);
    registerFitVerbs(app);
    registerCurveVerbs(app);
    registerGeoVerbs(app);
    registerTimeVerbs(app);
    registerLocalizeVerbs(app);
    registerResectVerbs(app);
    registerProfileVerbs(app);
    registerRoadVerbs(app);
    registerTraverseVerbs(app);
    registerViewVerbs(app);
    registerAreaVerbs(app);
    registerAlignVerbs(app);

    try {
      app.parse(argc, argv);
    } catch (const CLI::CallForHelp& e) {
      return app.exit(e);
    } catch (const CLI::CallForAllHelp& e) {
      return app.exit(e);
    } catch (const CLI::RuntimeError& e) {
      // Raised by a verb after all its rows are written: the bad rows are already reported.
      return e.get_exit_code();
    } catch (const CLI::Error& e) {
      std::cerr << "svy: " << e.what() << '\n';
      return kExitUsage;
    }
  } catch (const std::exception& e) {
    // Out of memory or a fault in a verb: still one line and a failing status, never an abort.
    std::cerr << "svy: " << e.what() << '\n';
    return kExitBadRows;
  }
  return kExitOk;
}

}  // namespace svy_tool
