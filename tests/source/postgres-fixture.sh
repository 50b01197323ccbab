#!/usr/bin/env bash
# A PostgreSQL server for the tests of the accounting-database access, with the demo accounting
# tables, reachable through the ODBC driver registered under the name "SQL Server".
#
#   postgres-fixture.sh start FOLDER DEMO_DATABASE SCHEMA_SQL
#   postgres-fixture.sh stop FOLDER
#
# start: creates a cluster in a folder of its own under the system's temporary folder (recorded
# in FOLDER/server-folder), starts it on 127.0.0.1 at a free port, creates the database
# "accounting" with the tables of SCHEMA_SQL and the rows of the SQLite file DEMO_DATABASE, two
# logins that may read them, and writes
#   FOLDER/odbc/odbcinst.ini   "SQL Server" -> the PostgreSQL ODBC driver (point ODBCSYSINI here)
#   FOLDER/fixture.ini         port, a port where nothing listens, database, logins, passwords
# PostgreSQL refuses to run as root; as root the server runs as the user "postgres", who owns the
# server's folder. That folder is not inside FOLDER: the user "postgres" cannot reach a checkout
# below a private folder (root's home, a folder made by mktemp -d), and the user's own folders are
# not opened to others for it. When the start fails it says why, with the last lines of the logs.
# stop: stops the server and removes its folder, also after a start that failed half-way.
set -euo pipefail

command=${1:-}
folder=${2:-}
if [ -z "$command" ] || [ -z "$folder" ]; then
    echo "usage: postgres-fixture.sh start FOLDER DEMO_DATABASE SCHEMA_SQL | stop FOLDER" >&2
    exit 2
fi
record="$folder/server-folder"

bin=$(ls -d /usr/lib/postgresql/*/bin 2>/dev/null | sort -V | tail -n 1)
if [ -z "$bin" ]; then
    echo "postgres-fixture.sh: PostgreSQL is not installed (Debian: apt-get install postgresql)" >&2
    exit 1
fi

as_server_user() {
    if [ "$(id -u)" -eq 0 ]; then
        # From "/": the user "postgres" may not be allowed into the current folder.
        (cd / && exec runuser -u postgres -- "$@")
    else
        "$@"
    fi
}

# The server's folder from the record, if it is one that the start made (never anything else).
recorded_server_folder() {
    [ -f "$record" ] || return 0
    local recorded
    recorded=$(cat "$record")
    case "$(basename -- "$recorded")" in
    zorbin-postgres.*) [ -d "$recorded" ] && echo "$recorded" ;;
    esac
    return 0
}

# Stops the recorded server and removes its folder and the record.
stop_and_remove() {
    local server_folder
    server_folder=$(recorded_server_folder)
    if [ -n "$server_folder" ]; then
        if [ -f "$server_folder/data/postmaster.pid" ]; then
            as_server_user "$bin/pg_ctl" -D "$server_folder/data" -m fast -w stop >/dev/null || true
        fi
        rm -rf -- "$server_folder"
    fi
    rm -f -- "$record"
}

port_is_free() {
    ! (exec 3<>"/dev/tcp/127.0.0.1/$1") 2>/dev/null
}

free_port() {  # the first free port from $1 on
    local port=$1
    while ! port_is_free "$port"; do
        port=$((port + 1))
    done
    echo "$port"
}

case "$command" in
stop)
    stop_and_remove
    exit 0
    ;;
start) ;;
*)
    echo "postgres-fixture.sh: unknown command $command" >&2
    exit 2
    ;;
esac

demo=${3:?the demo database}
# sqlite3 would create an empty file in its place, which the build then takes for the demo.
if [ ! -s "$demo" ]; then
    echo "postgres-fixture.sh: no demo database at $demo (build the target zorbin-demo)" >&2
    exit 1
fi
schema=${4:?the schema file}
superuser_password=fixture-super
reader=catalog
reader_password=catalog-reader
# A password that breaks an ODBC connection string unless it is put between braces.
tricky=catalog_tricky
tricky_password='sem;i}co{lon'

# What a previous run left behind (a run that was killed before its stop step).
stop_and_remove
mkdir -p "$folder/odbc"
rm -f "$folder/fixture.ini"

# A start that fails says why, then leaves nothing running and nothing behind.
failed_start() {
    local status=$?
    trap - EXIT
    [ "$status" -eq 0 ] && return 0
    echo "postgres-fixture.sh: the PostgreSQL test server could not be made ready (status $status)." >&2
    if [ -s "$log" ]; then
        echo "--- the last lines of $log:" >&2
        tail -n 20 "$log" >&2
    fi
    stop_and_remove
    exit "$status"
}
initdb_log="$folder/initdb.log"
log="" # the log of the step under way
rm -f "$initdb_log"
trap failed_start EXIT

# The server's folder: the system's temporary folder as root (the user "postgres" can reach it),
# the user's own otherwise. It is recorded at once, so that the stop step finds it whatever fails.
if [ "$(id -u)" -eq 0 ]; then
    server_folder=$(mktemp -d /tmp/zorbin-postgres.XXXXXXXX)
    echo "$server_folder" >"$record"
    chown postgres "$server_folder"
else
    server_folder=$(mktemp -d "${TMPDIR:-/tmp}/zorbin-postgres.XXXXXXXX")
    echo "$server_folder" >"$record"
fi
data="$server_folder/data"
server_log="$server_folder/server.log"

password_file="$server_folder/superuser-password"
(umask 077 && echo "$superuser_password" >"$password_file")
if [ "$(id -u)" -eq 0 ]; then
    chown postgres "$password_file"
fi
log=$initdb_log
as_server_user "$bin/initdb" -D "$data" -U postgres --auth-host=scram-sha-256 --auth-local=trust \
    --pwfile="$password_file" -E UTF8 --locale=C.UTF-8 >"$initdb_log" 2>&1
rm -f "$password_file"

log=$server_log
# Another test run may take the port between the check and the start: try the next one then.
port=$(free_port 55432)
for attempt in 1 2 3 4 5; do
    if as_server_user "$bin/pg_ctl" -D "$data" -l "$server_log" -w \
        -o "-c listen_addresses=127.0.0.1 -c port=$port -c unix_socket_directories=''" start >/dev/null; then
        break
    fi
    [ "$attempt" -eq 5 ] && exit 1
    port=$(free_port $((port + 1)))
done
closed_port=$(free_port $((port + 1)))

# Over TCP only: no socket file is needed anywhere.
psql() {
    as_server_user env PGPASSWORD="$superuser_password" \
        "$bin/psql" -X -q -v ON_ERROR_STOP=1 -h 127.0.0.1 -p "$port" -U postgres "$@"
}
psql -d postgres <<SQL
CREATE ROLE $reader LOGIN PASSWORD '$reader_password';
CREATE ROLE $tricky LOGIN PASSWORD '${tricky_password//\'/\'\'}';
CREATE DATABASE accounting ENCODING 'UTF8' TEMPLATE template0;
SQL
psql -d accounting < "$schema"
for table in Items ExtraNotes ExtraNoteNames PriceListNames PriceListsLastDateWithSub ItemSortNames Accounts; do
    {
        echo "BEGIN;"
        sqlite3 "$demo" ".mode insert $table" "SELECT * FROM $table;"
        echo "COMMIT;"
    } | psql -d accounting
done
psql -d accounting <<SQL
GRANT SELECT ON ALL TABLES IN SCHEMA public TO $reader, $tricky;
SQL

cat > "$folder/odbc/odbcinst.ini" <<INI
[SQL Server]
Description=PostgreSQL under the name of the SQL Server driver, for the tests
Driver=psqlodbcw.so
INI
cat > "$folder/fixture.ini" <<INI
[server]
port=$port
closedPort=$closed_port
database=accounting
user=$reader
password=$reader_password
trickyUser=$tricky
trickyPassword="$tricky_password"
INI
trap - EXIT
echo "PostgreSQL is listening on 127.0.0.1:$port (data in $data)"
