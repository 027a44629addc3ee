# Functions for the scripts: install missing Debian packages, build, and make data for a run.

. demo/data.sh

BuildPackages=(g++ cmake ninja-build qt6-base-dev qt6-base-dev-tools qt6-serialport-dev qt6-multimedia-dev libsqlite3-dev
  sqlite3 libsndfile1-dev libsamplerate0-dev libmicrohttpd-dev libqrencode-dev libpugixml-dev zlib1g-dev nettle-dev libxcb1-dev nlohmann-json3-dev mdbtools-dev pkg-config libreoffice-dev libqpdf-dev libgtest-dev libgmock-dev libbenchmark-dev
  cmark-gfm lld)
RunPackages=(libreoffice-writer qt6-translations-l10n fonts-dejavu-core fonts-liberation fonts-noto-cjk)
TestPackages=(cups-daemon dbus-daemon xvfb)
DisplayPackages=(xvfb xauth poppler-utils)
PicturePackages=(pngquant)
PackagingPackages=(debhelper git)  # to build the packages
PackageCheckPackages=(lintian desktop-file-utils appstream shared-mime-info libglib2.0-bin man-db udev usb.ids)
CheckPackages=(clang clang-format clang-tidy libclang-rt-14-dev git)

# RequirePackages NAME...: installs the missing ones, as root or with sudo.
RequirePackages() {
  local missing=() package
  for package in "$@"; do
    [ "$(dpkg-query -W -f='${Status}' "$package" 2>/dev/null)" = "install ok installed" ] || missing+=("$package")
  done
  [ ${#missing[@]} -eq 0 ] && return 0
  local asRoot=()
  if [ "$(id -u)" -ne 0 ]; then
    command -v sudo > /dev/null || { echo "Missing packages: ${missing[*]} (install them, or run this as root)" >&2; return 1; }
    asRoot=(sudo)
  fi
  echo "Installing ${missing[*]}"
  "${asRoot[@]}" apt-get update -qq
  "${asRoot[@]}" env DEBIAN_FRONTEND=noninteractive apt-get install -y -qq --no-install-recommends "${missing[@]}" > /dev/null
}

# Build PRESET [TARGET...]: configures and builds all targets, or only those named.
Build() {
  local preset=$1
  shift
  cmake --preset "$preset" > /dev/null
  cmake --build --preset "$preset" ${1:+--target "$@"}
}

# RunTests PRESET [OPTION...]: runs the tests, more at a time than there are processors, since many only wait for a line or
# another program.
RunTests() {
  local preset=$1
  shift
  ctest --preset "$preset" -j $((2 * $(nproc))) "$@"
}

HasDisplay() { [ -n "${DISPLAY:-}${WAYLAND_DISPLAY:-}" ]; }
