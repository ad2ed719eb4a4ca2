#!/usr/bin/env bash
# Stops or starts the server of a test run, keeping its data; the tests stop
# it to see how the card takes a vanished server, then start it again.
#   pg_ctl.sh <state file> stop|start
set -euo pipefail
state=$1
action=$2
# shellcheck disable=SC1090
. "$state"
as_owner() {
  if [ "$(id -u)" -eq 0 ]; then runuser -u postgres -- "$@"; else "$@"; fi
}
case "$action" in
  stop)
    [ -f "$PG_RUN/data/postmaster.pid" ] || exit 0
    as_owner "$PG_BIN/pg_ctl" -D "$PG_RUN/data" -m fast -w -t 60 stop >/dev/null ;;
  start)
    as_owner "$PG_BIN/pg_ctl" -D "$PG_RUN/data" -l "$PG_RUN/server.log" -w -t 60 \
      -o "-c listen_addresses=127.0.0.1 -c port=$PG_PORT -c unix_socket_directories=$PG_RUN -c autovacuum=off -c fsync=off" \
      start >/dev/null ;;
  *) echo "pg_ctl.sh: stop or start" >&2; exit 2 ;;
esac
