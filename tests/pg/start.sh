#!/usr/bin/env bash
# Starts a private PostgreSQL server for the server tests and loads the
# fixture companies into it.
#   start.sh <state file> <pg_loader>
# Everything lives in a new temporary directory: the data directory, the
# Unix socket, the server log and a private ODBC configuration (ODBCSYSINI):
#   - a driver entry named "SQL Server" that points at the PostgreSQL ODBC
#     driver, so that the card's type-1 string
#     "driver={SQL Server};server=127.0.0.1;uid=...;pwd=...;database=..."
#     reaches this server through the real driver manager as it is built;
#   - one data source per database (type 5: "DSN=<database>;uid=...;pwd=...").
# The type-1 string has no port. The server takes 5432 when that is free and
# the next free port from 15432 otherwise; the port reaches the ODBC driver
# through PGPORT, which the driver leaves to the client library when the
# string names no port (a "Port" line in the driver's odbcinst.ini entry is
# not read for a driver string). The state file records the directory and
# the port as shell assignments for the tests, pg_ctl.sh and stop.sh.
set -euo pipefail

state=$1
loader=$2
bin=$(ls -d /usr/lib/postgresql/*/bin 2>/dev/null | sort -V | tail -n 1)
[ -x "$bin/initdb" ] || { echo "start.sh: no PostgreSQL server binaries" >&2; exit 1; }
driver=$(find /usr/lib -name psqlodbcw.so 2>/dev/null | head -n 1)
[ -n "$driver" ] || { echo "start.sh: no PostgreSQL ODBC driver" >&2; exit 1; }

# A run left behind by an interrupted earlier start is stopped first.
if [ -f "$state" ]; then
  "$(dirname "$0")/stop.sh" "$state" || true
fi

run=$(mktemp -d "${TMPDIR:-/tmp}/ardcard-pg.XXXXXX")
chmod 755 "$run"

# initdb and the server refuse to run as root.
as_owner() {
  if [ "$(id -u)" -eq 0 ]; then runuser -u postgres -- "$@"; else "$@"; fi
}
if [ "$(id -u)" -eq 0 ]; then chown postgres "$run"; fi

port_taken() {
  if command -v ss >/dev/null; then
    ss -Hltn "sport = :$1" | grep -q .
  else
    (exec 3<>"/dev/tcp/127.0.0.1/$1") 2>/dev/null
  fi
}

read -r user password < <("$loader" --login)

as_owner "$bin/initdb" -D "$run/data" -U postgres -E UTF8 --no-locale \
  --auth-local=trust --auth-host=scram-sha-256 >"$run/initdb.log"

# Autovacuum off: statistics gathered in the middle of a run could change a
# plan, and with it the order in which rows come back.
started=
for port in 5432 $(seq 15432 15531); do
  port_taken "$port" && continue
  if as_owner "$bin/pg_ctl" -D "$run/data" -l "$run/server.log" -w -t 60 \
      -o "-c listen_addresses=127.0.0.1 -c port=$port -c unix_socket_directories=$run -c autovacuum=off -c fsync=off" \
      start >/dev/null; then
    started=$port
    break
  fi
done
[ -n "$started" ] || { echo "start.sh: the server did not start" >&2; cat "$run/server.log" >&2; exit 1; }

cat >"$state" <<STATE
PG_RUN="$run"
PG_BIN="$bin"
PG_PORT="$started"
STATE

psql() { as_owner "$bin/psql" -h "$run" -p "$started" -U postgres -d postgres -v ON_ERROR_STOP=1 -q "$@"; }
psql -c "CREATE ROLE $user LOGIN PASSWORD '$password'"
for db in ardco1 ardco2 ardnoacc; do
  psql -c "CREATE DATABASE $db OWNER $user"
done

printf '[SQL Server]\nDescription=PostgreSQL server of the tests\nDriver=%s\n' "$driver" \
  >"$run/odbcinst.ini"
: >"$run/odbc.ini"
for db in ardco1 ardco2 ardnoacc; do
  printf '[%s]\nDriver=SQL Server\nServername=127.0.0.1\nPort=%s\nDatabase=%s\n\n' \
    "$db" "$started" "$db" >>"$run/odbc.ini"
done

mkdir -p "$run/sqlite"
ODBCSYSINI=$run ODBCINI=$run/odbc.ini PGPORT=$started "$loader" "$run/sqlite"
echo "PostgreSQL test server on 127.0.0.1:$started, directory $run"
