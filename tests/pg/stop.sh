#!/usr/bin/env bash
# Stops the test server that start.sh started and removes its directory.
#   stop.sh <state file>
set -euo pipefail
state=$1
[ -f "$state" ] || exit 0
# shellcheck disable=SC1090
. "$state"
"$(dirname "$0")/pg_ctl.sh" "$state" stop || true
case "$PG_RUN" in
  */ardcard-pg.*) rm -rf "$PG_RUN" ;;
esac
rm -f "$state"
