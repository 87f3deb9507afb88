#!/usr/bin/env bash
# Installs, from Debian's packages, what pendra needs and the machine lacks.
#   tools/install-deps.sh build   compiler, CMake, Qt 6, JSON and CLI libraries
#   tools/install-deps.sh test    the above, GoogleTest and the HDL tools the tests run
set -euo pipefail

build_packages=(g++ make cmake qt6-base-dev qt6-base-dev-tools nlohmann-json3-dev libcli11-dev fonts-dejavu-core)
test_packages=(googletest libgtest-dev verilator yosys iverilog ghdl)

wanted=("${build_packages[@]}")
if [ "${1:-build}" = "test" ]; then
  wanted+=("${test_packages[@]}")
fi

missing=()
for p in "${wanted[@]}"; do
  if ! dpkg-query -W -f='${Status}' "$p" 2>/dev/null | grep -q "install ok installed"; then
    missing+=("$p")
  fi
done

if [ ${#missing[@]} -eq 0 ]; then
  exit 0
fi

echo "Installing: ${missing[*]}"
sudo_cmd=()
if [ "$(id -u)" -ne 0 ]; then
  sudo_cmd=(sudo)
fi
export DEBIAN_FRONTEND=noninteractive
"${sudo_cmd[@]}" apt-get update -q
"${sudo_cmd[@]}" apt-get install -y -q --no-install-recommends "${missing[@]}"
