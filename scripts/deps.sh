# Sourced by the other scripts: installs the Debian packages given as arguments when any is missing.
# Nothing is downloaded when all of them are installed already (checked with dpkg -s).
svy_ensure_packages() {
  local missing=()
  local pkg
  for pkg in "$@"; do
    # A removed package whose configuration files remain is still known to dpkg: check its status line.
    dpkg -s "$pkg" 2>/dev/null | grep -q '^Status: install ok installed' || missing+=("$pkg")
  done
  if [ ${#missing[@]} -eq 0 ]; then
    return 0
  fi
  echo "Installing: ${missing[*]}"
  local sudo=""
  if [ "$(id -u)" -ne 0 ]; then
    if command -v sudo >/dev/null 2>&1; then
      sudo="sudo"
    else
      echo "error: missing packages (${missing[*]}) and not running as root" >&2
      return 1
    fi
  fi
  export DEBIAN_FRONTEND=noninteractive
  $sudo apt-get update
  $sudo apt-get install -y --no-install-recommends "${missing[@]}"
}

# What building the libraries and the svy tool needs.
SVY_BUILD_PACKAGES=(cmake ninja-build g++ libboost-dev libboost-system-dev libboost-thread-dev libcli11-dev
                    libpugixml-dev nlohmann-json3-dev libgeographiclib-dev ccache)
# And what the test suite, the sanitizer build and the benchmarks need on top.
SVY_TEST_PACKAGES=("${SVY_BUILD_PACKAGES[@]}" clang libgtest-dev libgmock-dev libbenchmark-dev)
