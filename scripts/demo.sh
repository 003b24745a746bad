#!/usr/bin/env bash
# Installs what is missing, builds the command and asks it about the sample repositories.
set -euo pipefail
cd "$(dirname "$0")/.."

scripts/install-dependencies.sh build
cmake -S . -B build/demo -G Ninja -DCMAKE_BUILD_TYPE=Release -DKEL_BUILD_TESTS=OFF >/dev/null
cmake --build build/demo

show() {
  printf '\n$ kel %s\n' "$*"
  build/demo/bin/kel "$@"
}
show -L examples/repository list
show -L examples/overlay -L examples/repository which word_fifo pulse_counter_v1_00_a pulse_counter
show -L examples/repository show word_fifo --section ports
show -L examples/repository sources event_station --for simulation
show -L examples/repository netlists crc_unit --set WIDTH=16
