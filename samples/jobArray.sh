#!/bin/sh
# One task of a job array: cleans its share of a folder of photos. Every cluster scheduler can run it; it tells the task
# the task's number and how many there are:
#
#   Slurm    sbatch --array=1-16 samples/jobArray.sh PHOTOS RESULTS [option...]
#   Grid     qsub -t 1-16 samples/jobArray.sh PHOTOS RESULTS [option...]
#   by hand  TASK=3 TASKS=16 samples/jobArray.sh PHOTOS RESULTS [option...]
#
# PHOTOS and RESULTS are folders that all machines see. STILLMARK names the program where it is not on the PATH.
set -eu

[ $# -ge 2 ] || { echo "usage: jobArray.sh PHOTOS RESULTS [option...]" >&2; exit 2; }
photos=$1 results=$2
shift 2
task=${TASK:-${SLURM_ARRAY_TASK_ID:-${SGE_TASK_ID:-1}}}
tasks=${TASKS:-${SLURM_ARRAY_TASK_COUNT:-${SGE_TASK_LAST:-1}}}

mkdir -p "$results"
# Each task has the same list in the same order, and takes every tasks-th photo of it.
LC_ALL=C
export LC_ALL
exec "${STILLMARK:-stillmark}" "$photos"/*.* --out-dir "$results" --shard "$task/$tasks" --threads "${THREADS:-1}" --quiet "$@"
