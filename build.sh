#!/usr/bin/env bash
# The one door to building: installs what is missing on a Debian 12 machine, builds, runs.
#
#   ./build.sh build        builds the release into build/release/bin
#   ./build.sh demo         builds and converts an example motion
#   ./build.sh test         builds and runs all tests
#   ./build.sh asan         the same tests under AddressSanitizer and UndefinedBehaviorSanitizer
#   ./build.sh thread-test  the tests of the library under ThreadSanitizer
#   ./build.sh bench        runs the benchmarks: ratios within one run
#   ./build.sh fuzz [SECONDS]  feeds every reader with broken files, 60 seconds each
#   ./build.sh package      makes Debian packages in build/release/packages and tries them, and a .zip for Windows in
#                           build/windows/packages if its compiler is there
#   ./build.sh windows      builds the shell program for Windows into build/windows/bin
#   ./build.sh windows-test runs its tests with wine, and compares its results with those of the program of this system
#   ./build.sh cluster-test runs the lines of docs/clusters.md with Slurm and GNU parallel on this machine
#   ./build.sh lint [COUNT]  checks formatting and runs the linter, on all sources or on those that were changed last
set -euo pipefail
cd "$(dirname "$0")"

# What a bare machine needs, by purpose; README.md says why each is there.
packages_build=(g++ cmake ninja-build pkg-config ccache)
packages_engine=(libcli11-dev nlohmann-json3-dev libxxhash-dev libmagick++-6.q16-dev libassimp-dev libseccomp-dev)
packages_preview=(libgl-dev libglu1-mesa-dev libegl-dev libpng-dev libfreetype-dev libfontconfig-dev libgl1-mesa-dri)
packages_python=(pybind11-dev python3-dev python3-numpy python3-matplotlib)
packages_desktop=(qt6-base-dev libqt6opengl6-dev qt6-svg-dev libqt6svg6 qt6-qpa-plugins libx11-dev libgl1-mesa-dri fonts-dejavu-core)
packages_package=(dpkg-dev file lintian desktop-file-utils appstream shared-mime-info man-db)
packages_test=(libgtest-dev libgmock-dev locales python3 xvfb xauth xdotool dbus-daemon zsh fish)
packages_bench=(libbenchmark-dev python3 time)
packages_cluster=(slurm-wlm munge parallel)
packages_lint=(clang-format clang-tidy)
packages_windows=(g++-mingw-w64-x86-64-posix googletest wine64 python3)
packages_fuzz=(clang libclang-rt-14-dev python3)

need() {
  local missing=()
  for package in "$@"; do
    dpkg-query -W -f='${db:Status-Abbrev}' "$package" 2>/dev/null | grep -q '^ii' || missing+=("$package")
  done
  [ ${#missing[@]} -eq 0 ] && return
  local sudo=""
  [ "$(id -u)" -eq 0 ] || sudo=sudo
  echo "Installing: ${missing[*]}"
  $sudo apt-get -o DPkg::Lock::Timeout=600 update -qq
  DEBIAN_FRONTEND=noninteractive $sudo apt-get -o DPkg::Lock::Timeout=600 install -y -qq --no-install-recommends \
    "${missing[@]}" >/dev/null
}

# build PRESET [TARGETS...]: configures once and builds the targets, by default everything.
build() {
  local preset=$1
  shift
  [ -f "build/$preset/build.ninja" ] || cmake --preset "$preset" >/dev/null
  cmake --build --preset "$preset" ${1:+--target "$@"}
}

# run_tests PRESET: real motions lie beside the project on some machines; the tests use them where they are.
run_tests() {
  local data
  data=$(realpath -m ../shared/data)
  [ -d "$data" ] && export GAITWRIGHT_TEST_DATA="$data"
  ctest --test-dir "build/$1" --output-on-failure --no-tests=error -j "$(nproc)"
}

prepare() {
  need "${packages_build[@]}" "${packages_engine[@]}" "${packages_preview[@]}" "${packages_python[@]}" "${packages_desktop[@]}" "${packages_test[@]}" \
    "${packages_package[@]}" libbenchmark-dev
}

demo() {
  local bin=build/release/bin
  out=$(mktemp -d) # not local: the trap looks at it when the script is over
  trap 'rm -rf "$out"' EXIT
  echo "\$ gaitwright convert examples/walk.bvh -o walk.Kinetra"
  "$bin/gaitwright" convert examples/walk.bvh -o "$out/walk.Kinetra"
  echo "\$ gaitwright info walk.Kinetra"
  "$bin/gaitwright" info "$out/walk.Kinetra"
}

# run_fuzzer NAME SECONDS: from the seeds, from what once broke something and from what earlier runs found. A
# finding stays in build/fuzz/findings; its text says which promise is broken.
run_fuzzer() {
  local found=build/fuzz/found/$1 findings=build/fuzz/findings/$1 log=build/fuzz/log/$1
  mkdir -p "$found" "$findings" build/fuzz/log
  local inputs=("$found" "build/fuzz/fuzz/corpus/$1")
  [ -d "fuzz/regressions/$1" ] && inputs+=("fuzz/regressions/$1")
  local options=(-timeout=5 -max_len=65536 -rss_limit_mb=2560 -print_final_stats=1 "-artifact_prefix=$findings/")
  if "build/fuzz/bin/fuzz_$1" "${options[@]}" -max_total_time="$2" -close_fd_mask=3 "-dict=fuzz/dictionaries/$1.dict" \
    "${inputs[@]}" >"$log" 2>&1; then
    echo "$1: $(sed -n 's/^stat::number_of_executed_units: *//p' "$log") inputs, nothing found"
    return 0
  fi
  echo "$1: broken by"
  find "$findings" -type f -newer build/fuzz/begun -print -exec "build/fuzz/bin/fuzz_$1" {} \; 2>&1 | head -n 40
  return 1
}

# In memory where there is a file system in memory: each input is a file.
fuzz() {
  local name failed=0
  fuzz_folder=$(mktemp -d -p "$([ -d /dev/shm ] && echo /dev/shm || echo /tmp)") # not local, for the trap
  trap 'rm -rf "$fuzz_folder"' EXIT
  export TMPDIR=$fuzz_folder
  touch build/fuzz/begun
  for name in fuzz/dictionaries/*.dict; do
    run_fuzzer "$(basename "$name" .dict)" "$1" || failed=1
  done
  return $failed
}

# sources_to_lint [COUNT]: all sources, or the ones that were changed last, also by way of their header. The shim of
# tests/faults replaces functions of the C library under their reserved names.
sources_to_lint() {
  if [ -z "${1:-}" ]; then
    git ls-files '*.cpp'
  else
    git log --format= --name-only -- '*.cpp' '*.h' | sed 's/\.h$/.cpp/' | awk '!seen[$0]++' |
      grep -Fxf <(git ls-files '*.cpp') | sed "$1q"
  fi | grep -vE '^(bench/load_baseline|examples/|tests/faults/FaultShim)|/windows/' || true
}

# Each source is checked by itself: the linter reads the commands of the preset that joins none.
lint() {
  git ls-files '*.cpp' '*.h' | xargs clang-format --dry-run --Werror
  cmake --preset dev >/dev/null
  sources_to_lint "${1:-}" | xargs -r -P "$(nproc)" -n 4 clang-tidy -p build/dev --quiet
}

case "${1:-}" in
build)
  prepare
  build release
  ;;
demo)
  prepare
  build release shell
  demo
  ;;
test)
  prepare
  build release
  run_tests release
  ;;
package)
  prepare
  build release
  ctest --test-dir build/release --output-on-failure --no-tests=error -R '^package' -j "$(nproc)"
  ls -l build/release/packages/*.deb
  if command -v x86_64-w64-mingw32-g++-posix >/dev/null && [ -d /usr/src/googletest ]; then
    build windows gaitwright assets
    (cd build/windows && cpack -B packages >/dev/null)
    ls -l build/windows/packages/*.zip
  fi
  ;;
windows)
  need "${packages_build[@]}" "${packages_engine[@]}" "${packages_windows[@]}"
  build windows gaitwright assets
  ;;
windows-test)
  prepare
  need "${packages_windows[@]}"
  build release shell
  cmake/windows/emulate.sh cmd /c ver >/dev/null 2>&1 || true # makes wine's files before tests need them at once
  build windows
  run_tests windows
  GAITWRIGHT_TEST_DATA=$(realpath ../shared/data) python3 tests/windows/compare_programs.py \
    build/release/bin/gaitwright build/windows/bin/gaitwright.exe cmake/windows/emulate.sh
  ;;
asan)
  prepare
  build asan
  export LSAN_OPTIONS="suppressions=$PWD/tests/lsan.supp:print_suppressions=0"
  run_tests asan
  ;;
thread-test)
  prepare
  build tsan
  TSAN_OPTIONS="halt_on_error=1" build/tsan/bin/library_tests
  ;;
bench)
  need "${packages_build[@]}" "${packages_engine[@]}" "${packages_preview[@]}" "${packages_python[@]}" "${packages_desktop[@]}" "${packages_test[@]}" "${packages_bench[@]}"
  build release
  build/release/bin/gaitwright_bench
  python3 bench/whole_process.py build/release/bin --what one four chosen faithful info choice
  python3 bench/growth.py build/release/bin
  ;;
fuzz)
  need "${packages_build[@]}" "${packages_engine[@]}" "${packages_preview[@]}" "${packages_fuzz[@]}"
  build fuzz
  fuzz "${2:-60}"
  ;;
cluster-test)
  prepare
  need "${packages_cluster[@]}"
  build release
  tests/cluster/cluster_test.sh build/release/bin
  ;;
lint)
  need "${packages_build[@]}" "${packages_engine[@]}" "${packages_preview[@]}" "${packages_python[@]}" "${packages_desktop[@]}" "${packages_test[@]}" "${packages_lint[@]}" libbenchmark-dev
  lint "${2:-}"
  ;;
*)
  sed -n '4,18s/^# *//p' "$0"
  exit 2
  ;;
esac
