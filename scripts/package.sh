#!/usr/bin/env bash
# Builds the Debian packages into build/package, and proves that they are good: installs them below a
# scratch directory, builds examples/consumer against that with CMake and with pkg-config and a plain
# compiler call, asks the command, and removes them again. Then it does the same for a plain
# installation under DESTDIR, for static libraries, and for a project that adds this one.
# Usage: package.sh
set -euo pipefail
cd "$(dirname "$0")/.."

scripts/install-dependencies.sh build package
home=$PWD
scratch=$(mktemp -d)
trap 'rm -rf "$scratch"' EXIT

say() { printf '== %s\n' "$*"; }

# Builds the consumer in a directory of its own and compares what it prints with the README.
consume_by_cmake() { # NAME CMAKE_ARGUMENT...
  local name=$1
  shift
  cmake -S examples/consumer -B "$scratch/$name" -G Ninja "$@" >/dev/null
  cmake --build "$scratch/$name" >/dev/null
  expect_ports "$scratch/$name/program"
}

# No module but ours is there to be found: who links the shared library needs no other.
consume_by_pkg_config() { # LIBRARY_DIRECTORY PKG_CONFIG_ARGUMENT...
  local libraries=$1
  shift
  local -x PKG_CONFIG_LIBDIR=$libraries/pkgconfig
  # Words of several flags are to be split.
  # shellcheck disable=SC2046
  g++ -std=c++17 $(pkg-config --cflags tarvo-kel) examples/consumer/program.cpp -o "$scratch/plain" \
    $(pkg-config --libs "$@" tarvo-kel) -Wl,-rpath,"$libraries"
  expect_ports "$scratch/plain"
}

expect_ports() { # PROGRAM
  "$1" | tail -n +2 | diff - <(printf '  %s\n' clk rst pulse bus_sel bus_write bus_addr bus_wdata bus_rdata irq)
}

expect_command() { # KEL
  diff <("$1" -L examples/repository list | cut -f 1 | sed 's/_v[0-9].*//') \
    <(printf '%s\n' examples/repository/ipmods/* | sed 's/.*\///; s/_v[0-9].*//' | sort -u)
}

say "packages"
cmake -S . -B build/package -G Ninja -DCMAKE_BUILD_TYPE=Release -DCMAKE_INSTALL_PREFIX=/usr \
  -DKEL_BUILD_TESTS=OFF >/dev/null
cmake --build build/package
rm -f build/package/*.deb
(cd build/package && cpack >/dev/null)
root=$scratch/root
mkdir -p "$root/var/lib/dpkg/info" "$root/var/lib/dpkg/updates"
touch "$root/var/lib/dpkg/status"
# What the packages need is on this machine, and not below the scratch directory.
in_root=(dpkg --root="$root" --force-not-root --force-depends --force-script-chrootless --log=/dev/null)
"${in_root[@]}" --install build/package/*.deb >"$scratch/log" 2>&1 || { cat "$scratch/log"; exit 1; }
libraries=$(dirname "$(find "$root/usr/lib" -name libtarvo_kel.so)")
expect_command "$root/usr/bin/kel"
consume_by_cmake packaged -DCMAKE_PREFIX_PATH="$root/usr"
consume_by_pkg_config "$libraries"
"${in_root[@]}" --remove kel libtarvo-kel-dev libtarvo-kel0 >"$scratch/log" 2>&1 ||
  { cat "$scratch/log"; exit 1; }
left=$(find "$root" -not -path "$root/var/*" -type f)
[ -z "$left" ] || { echo "left behind: $left"; exit 1; }

say "an installation under DESTDIR, in a prefix of its own"
DESTDIR=$scratch/staged cmake --install build/package --prefix /opt/kel >/dev/null
mv "$scratch/staged/opt/kel" "$scratch/moved"
libraries=$(dirname "$(find "$scratch/moved" -name libtarvo_kel.so)")
expect_command "$scratch/moved/bin/kel"
consume_by_cmake moved -DCMAKE_PREFIX_PATH="$scratch/moved"
consume_by_pkg_config "$libraries"

say "the build tree"
consume_by_cmake tree -DTarvoKel_DIR="$home/build/package"

say "static libraries"
cmake -S . -B build/static -G Ninja -DCMAKE_BUILD_TYPE=Release -DBUILD_SHARED_LIBS=OFF \
  -DKEL_BUILD_TESTS=ON -DCMAKE_INSTALL_PREFIX="$scratch/static" >/dev/null
cmake --build build/static
(cd build/static && ctest -j2 --output-on-failure -E 'Sizes|Tools' | tail -n 3)
cmake --install build/static >/dev/null
libraries=$(dirname "$(find "$scratch/static" -name libtarvo_kel.a)")
consume_by_cmake static-cmake -DCMAKE_PREFIX_PATH="$scratch/static"
modules=$(pkg-config --variable pc_path pkg-config)
PKG_CONFIG_PATH=$modules consume_by_pkg_config "$libraries" --static

say "a project that adds this one"
mkdir "$scratch/parent"
cat >"$scratch/parent/CMakeLists.txt" <<END
cmake_minimum_required(VERSION 3.25)
project(Parent LANGUAGES CXX)
add_subdirectory($home kel)
add_executable(program $home/examples/consumer/program.cpp)
target_link_libraries(program PRIVATE TarvoKel::kel)
END
cmake -S "$scratch/parent" -B "$scratch/parent/build" -G Ninja >/dev/null
cmake --build "$scratch/parent/build" --target program >/dev/null
expect_ports "$scratch/parent/build/program"
say "all good: $(cd build/package && echo *.deb)"
