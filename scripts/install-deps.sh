#!/usr/bin/env bash
# Installs what the build, the tests and the demo need from Debian's packages.
# Runs apt-get only when something is missing, so a second run costs nothing.
set -euo pipefail

packages=(
  build-essential cmake ninja-build pkg-config
  libboost-dev libboost-date-time-dev
  librabbitmq-dev libssl-dev openssl
  libgtest-dev libgmock-dev googletest libbenchmark-dev
  clang libclang-rt-14-dev
  rapidjson-dev libsimdjson-dev
  libsqlite3-dev
  # the Python module kvveldra and its tests
  pybind11-dev python3-dev python3-pytest
  # the browser tests (kvtag serve's page in headless Chromium)
  chromium chromium-driver python3-selenium
  # cpack -G DEB: dpkg-shlibdeps, file, readelf; the package test: lintian
  dpkg-dev file binutils lintian
)
# --with-cluster: the broker and haproxy, for the cluster tests.
case "${1:-}" in
  --with-broker) packages+=(rabbitmq-server) ;;
  --with-cluster) packages+=(rabbitmq-server haproxy) ;;
esac

missing=()
for p in "${packages[@]}"; do
  if ! dpkg-query -W -f='${Status}' "$p" 2>/dev/null | grep -q 'install ok installed'; then
    missing+=("$p")
  fi
done

if [ ${#missing[@]} -eq 0 ]; then
  exit 0
fi

echo "Installing: ${missing[*]}"
SUDO=""
if [ "$(id -u)" -ne 0 ]; then SUDO="sudo"; fi
export DEBIAN_FRONTEND=noninteractive
$SUDO apt-get update
$SUDO apt-get install -y --no-install-recommends "${missing[@]}"
