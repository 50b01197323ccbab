#!/usr/bin/env bash
# A PostgreSQL server for the tests of the accounting-database access, with the demo accounting
# tables, reachable through the ODBC driver registered under the name "SQL Server".
#
#   postgres-fixture.sh start FOLDER DEMO_DATABASE SCHEMA_SQL
#   postgres-fixture.sh stop FOLDER
#
# start: creates a cluster in FOLDER/data, starts it on 127.0.0.1 at a free port, creates the
# database "accounting" with the tables of SCHEMA_SQL and the rows of the SQLite file
# DEMO_DATABASE, two logins that may read them, and writes
#   FOLDER/odbc/odbcinst.ini   "SQL Server" -> the PostgreSQL ODBC driver (point ODBCSYSINI here)
#   FOLDER/fixture.ini         port, a port where nothing listens, database, logins, passwords
# PostgreSQL refuses to run as root; as root the server runs as the user "postgres", who is given
# the folder. stop: stops the server and removes its data.
set -euo pipefail

command=${1:-}
folder=${2:-}
if [ -z "$command" ] || [ -z "$folder" ]; then
    echo "usage: postgres-fixture.sh start FOLDER DEMO_DATABASE SCHEMA_SQL | stop FOLDER" >&2
    exit 2
fi
data="$folder/data"

bin=$(ls -d /usr/lib/postgresql/*/bin 2>/dev/null | sort -V | tail -n 1)
if [ -z "$bin" ]; then
    echo "postgres-fixture.sh: PostgreSQL is not installed (Debian: apt-get install postgresql)" >&2
    exit 1
fi

as_server_user() {
    if [ "$(id -u)" -eq 0 ]; then
        runuser -u postgres -- "$@"
    else
        "$@"
    fi
}

stop_server() {
    if [ -f "$data/postmaster.pid" ]; then
        as_server_user "$bin/pg_ctl" -D "$data" -m fast -w stop >/dev/null || true
    fi
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
    stop_server
    rm -rf "$data"
    exit 0
    ;;
start) ;;
*)
    echo "postgres-fixture.sh: unknown command $command" >&2
    exit 2
    ;;
esac

demo=${3:?the demo database}
schema=${4:?the schema file}
superuser_password=fixture-super
reader=catalog
reader_password=catalog-reader
# A password that breaks an ODBC connection string unless it is put between braces.
tricky=catalog_tricky
tricky_password='sem;i}co{lon'

stop_server
rm -rf "$data"
mkdir -p "$data" "$folder/odbc"
if [ "$(id -u)" -eq 0 ]; then
    chown postgres "$folder" "$data"
fi
password_file="$folder/superuser-password"
echo "$superuser_password" > "$password_file"
chmod 644 "$password_file"
as_server_user "$bin/initdb" -D "$data" -U postgres --auth-host=scram-sha-256 --auth-local=trust \
    --pwfile="$password_file" -E UTF8 --locale=C.UTF-8 >"$folder/initdb.log"
rm -f "$password_file"

# Another test run may take the port between the check and the start: try the next one then.
port=$(free_port 55432)
for attempt in 1 2 3 4 5; do
    if as_server_user "$bin/pg_ctl" -D "$data" -l "$data/server.log" -w \
        -o "-c listen_addresses=127.0.0.1 -c port=$port -c unix_socket_directories=''" start >/dev/null; then
        break
    fi
    [ "$attempt" -eq 5 ] && { cat "$data/server.log" >&2; exit 1; }
    port=$(free_port $((port + 1)))
done
closed_port=$(free_port $((port + 1)))

# Over TCP only: a socket in the data folder of a deep checkout would pass the 107 bytes that a
# socket path may have, and the server would not start.
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
echo "PostgreSQL is listening on 127.0.0.1:$port (data in $data)"
