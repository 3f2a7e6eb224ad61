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
  export DEBIAN_FRONTEND=noninteractive
  svy_as_root apt-get update
  svy_as_root apt-get install -y --no-install-recommends "${missing[@]}"
}

# Runs a command as root: directly when root already, otherwise through sudo when there is one.
svy_as_root() {
  if [ "$(id -u)" -eq 0 ]; then
    "$@"
  elif command -v sudo >/dev/null 2>&1; then
    sudo "$@"
  else
    echo "error: '$*' needs root and there is no sudo" >&2
    return 1
  fi
}

# Generates the decimal-comma locale that the locale-independence tests switch to (a bare machine has only
# C and POSIX), unless one is there already.
svy_ensure_decimal_comma_locale() {
  if locale -a 2>/dev/null | grep -qiE '^(de_DE|fr_FR)\.utf-?8$'; then
    return 0
  fi
  echo "Generating the de_DE.UTF-8 locale"
  svy_as_root localedef -i de_DE -f UTF-8 de_DE.UTF-8
}

# What building the libraries and the svy tool needs.
SVY_BUILD_PACKAGES=(cmake ninja-build g++ libboost-dev libboost-system-dev libboost-thread-dev libcli11-dev
                    libpugixml-dev nlohmann-json3-dev libgeographiclib-dev ccache)
# And what the test suite, the sanitizer build and the benchmarks need on top.
# locales: a decimal-comma locale for the tests that prove number text ignores the process locale.
SVY_TEST_PACKAGES=("${SVY_BUILD_PACKAGES[@]}" clang libgtest-dev libgmock-dev libbenchmark-dev locales)
# The fuzzing build: clang's compiler runtime holds libFuzzer (-fsanitize=fuzzer).
SVY_FUZZ_PACKAGES=(clang libclang-rt-dev)
