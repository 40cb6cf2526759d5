#!/usr/bin/env bash
# Runs the lines of docs/clusters.md for real: an archive converted by Slurm with two nodes on this machine and by
# GNU parallel, with tasks killed midway and started again. Files and reports must be those of a single run.
#
#   cluster_test.sh FOLDER   with the programs in FOLDER
set -euo pipefail
root=$(cd "$(dirname "$0")/../.." && pwd)
bin=$(cd "$1" && pwd)
work=$(mktemp -d)
daemons=()
waiting="" # for tasks
shots=480 # so that a shard takes some seconds
export PATH="$bin:$PATH" SLURM_CONF="$work/slurm.conf"

cleanup() {
  local status=$?
  for daemon in $waiting "${daemons[@]}"; do kill "$daemon" 2>/dev/null || true; done
  for daemon in "${daemons[@]}"; do wait "$daemon" 2>/dev/null || true; done
  [ "$status" -eq 0 ] || tail -n 5 "$work"/*.log "$work"/*/*.log 2>/dev/null || true
  rm -rf "$work"
}
trap cleanup EXIT

fail() {
  echo "cluster-test: $*" >&2
  exit 1
}

# until_true SECONDS COMMAND...: tries until the command succeeds.
until_true() {
  local end=$((SECONDS + $1))
  shift
  until "$@" >/dev/null 2>&1; do
    [ $SECONDS -lt $end ] || fail "waited in vain for: $*"
    sleep 0.1
  done
}

# block NAME: the code of a name in the page.
block() {
  awk -v name="$1" '$0 == "```bash " name {on = 1; next} $0 == "```" {on = 0} on' "$root/docs/clusters.md" |
    grep . || fail "docs/clusters.md has no block $1"
}

make_archive() {
  local shot
  for shot in $(seq -w 1 $shots); do
    mkdir -p "archive/scene$((10#$shot % 7))"
    cp "$root/examples/walk.bvh" "archive/scene$((10#$shot % 7))/shot$shot.bvh"
  done
  head -c 9000 "$root/examples/walk.bvh" >archive/scene3/cut.bvh
  echo "no motion" >archive/scene5/none.bvh
}

# The reports of all runs name the same sources and ends; how long each took, and in which attempt, differs.
without_time() {
  sed -E 's/,"seconds":[0-9.]+(,"resumed":true)?//' "$1"
}

# files_in FOLDER: its results, without what is kept for another run.
files_in() {
  (cd "$1" && find . -type f ! -name '.gaitwright.resume.*' -exec sha256sum {} + | sort -k 2)
}

compare() {
  diff <(files_in "$work/one/results") <(files_in results) >/dev/null || fail "$1: other files"
  diff <(without_time "$work/one/report.jsonl") <(without_time report.jsonl) >/dev/null || fail "$1: another report"
  echo "cluster-test: $1: $(wc -l <report.jsonl) sources, the same files and the same report as one run"
}

count_results() {
  find results -name '*.Kinetra' 2>/dev/null | wc -l
}

has_results() {
  [ "$(count_results)" -ge "$1" ]
}

# The runs that work in this folder, and no other's.
runs_here() {
  local exe
  find /proc -mindepth 2 -maxdepth 2 -name exe -lname "$bin/gaitwright" 2>/dev/null | while read -r exe; do
    exe=${exe%/exe}
    [ "$(readlink "$exe/cwd")" != "$PWD" ] || echo "${exe#/proc/}"
  done
}

# Ends those that work when it is called, and not those that start later.
kill_runs() {
  local runs
  runs=$(runs_here)
  for run in $runs; do kill -KILL "$run" 2>/dev/null || true; done
  [ -n "$runs" ]
}

# enter NAME: a folder with the archive and its plan.
enter() {
  mkdir "$work/$1"
  cd "$work/$1"
  ln -s ../archive archive
  eval "$(block plan)" >/dev/null
}

# start LOG COMMAND...
start() {
  "${@:2}" >"$work/$1.log" 2>&1 &
  daemons+=($!)
}

start_slurm() {
  dd if=/dev/urandom of="$work/munge.key" bs=1024 count=1 2>/dev/null
  chmod 600 "$work/munge.key"
  mkdir "$work/state"
  start munged munged --foreground --force --key-file="$work/munge.key" --socket="$work/munge.socket" \
    --pid-file="$work/munge.pid" --seed-file="$work/munge.seed"
  until_true 20 munge -S "$work/munge.socket" -n
  sed -e "s|@WORK@|$work|g" -e "s|@HOST@|$(hostname -s)|g" -e "s|@USER@|$(id -un)|g" \
    "$root/tests/cluster/slurm.conf" >"$SLURM_CONF"
  start slurmctld slurmctld -D
  start slurmd1 slurmd -D -N n1
  start slurmd2 slurmd -D -N n2
  until_true 30 sh -c 'test "$(sinfo -h -t idle -o %D)" = 2'
}

submit() {
  eval "$(block slurm-submit)" >/dev/null 2>&1
}

no_runs() {
  [ -z "$(runs_here)" ]
}

chmod 755 "$work"
cd "$work"
make_archive
mkdir one
cd one
ln -s ../archive archive
gaitwright convert archive --out-dir results --profile "Poser BVH" --keep-going --report report.jsonl --quiet \
  2>/dev/null && fail "a single run named no broken file"

start_slurm
enter slurm
block slurm >convert.slurm
submit &
waiting=$!
until_true 60 has_results 20
until_true 60 kill_runs # the tasks that run; those that wait go on
until_true 60 has_results $((shots / 2))
job=$(squeue -h -o %A | head -n 1)
scancel "$job"
wait "$waiting" && fail "slurm: a killed task counts as done"
waiting=""
until_true 60 no_runs
before=$(count_results)
[ "$before" -lt $shots ] || fail "slurm: all was done before a task was killed"
eval "$(block merge)" >/dev/null 2>&1 && fail "slurm: a report with holes counts as whole"
submit && fail "slurm: broken files were not told"
eval "$(block merge)" >/dev/null 2>&1 && fail "slurm: broken files were not told"
echo "cluster-test: slurm: $before of $shots results when it was stopped"
compare slurm

enter parallel
eval "$(block parallel)" >/dev/null 2>&1 &
waiting=$!
until_true 60 has_results 20
until_true 60 kill_runs
wait "$waiting" && fail "parallel: a killed task counts as done"
waiting=""
before=$(count_results)
[ "$before" -lt $shots ] || fail "parallel: all was done before a task was killed"
eval "$(block parallel)" >/dev/null 2>&1 && fail "parallel: broken files were not told"
eval "$(block merge)" >/dev/null 2>&1 && fail "parallel: broken files were not told"
echo "cluster-test: parallel: $before of $shots results where tasks were killed"
compare parallel
