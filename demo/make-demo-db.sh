#!/usr/bin/env bash
# Builds the demo accounting database: a SQLite file shaped like the company database tables the
# catalog reads, the pictures its items refer to, and the settings that make a catalog of it.
#
# Usage: make-demo-db.sh [--items N] [--refer-to FOLDER] OUTPUT_FOLDER
#
#   OUTPUT_FOLDER     receives demo-accounting.db, pictures/ (PNG, GIF, BMP and JPEG files)
#                     and demo-settings.ini (the [Params] keys of the settings store: a type 3
#                     connection to the database file; cells show a picture, the item name, the
#                     key and a price; a file per page; largest picture 120 x 120).
#   --items N         instead of the small demo (about 300 varied items with nulls, blank names,
#                     a key held twice, the keys "#" and "*", several price lists and note kinds),
#                     N uniform items, each with a price in price lists 1 and 2 and notes of
#                     kinds 1 and 2. The benchmarks use --items 100000.
#   --refer-to FOLDER the folder where the files will be read from, when that is not
#                     OUTPUT_FOLDER (an installation staged under DESTDIR): picture references
#                     and the settings' connection name FOLDER.
#
# Needs bash, the sqlite3 command-line tool and ImageMagick's convert. The output is the same on
# every run: nothing random, no dates.
set -euo pipefail

usage() {
    echo "usage: make-demo-db.sh [--items N] [--refer-to FOLDER] OUTPUT_FOLDER" >&2
    exit 2
}
items=""
refer_to=""
while [ $# -gt 0 ]; do
    case "$1" in
        --items) [ $# -ge 2 ] || usage; items="$2"; shift 2 ;;
        --refer-to) [ $# -ge 2 ] || usage; refer_to="$2"; shift 2 ;;
        -h|--help) sed -n '2,/^[^#]/{/^#/p}' "$0"; exit 0 ;;
        -*) echo "make-demo-db.sh: unknown option $1" >&2; exit 2 ;;
        *) break ;;
    esac
done
[ $# -eq 1 ] || usage
if [ -n "$items" ] && ! [[ "$items" =~ ^[1-9][0-9]*$ ]]; then
    echo "make-demo-db.sh: --items needs a whole number above 0, not '$items'" >&2
    exit 2
fi

here=$(cd "$(dirname "$0")" && pwd)
mkdir -p "$1"
out=$(cd "$1" && pwd)
refer_to=${refer_to:-$out}
refer_to=${refer_to%/}
database="$out/demo-accounting.db"
pictures="$out/pictures"

# --- pictures: three of each format, of different shapes, so that sizing has work to do
mkdir -p "$pictures"
picture() {  # name width height colour-from colour-to
    local file="$pictures/$1" w=$2 h=$3 format=""
    [ "${1##*.}" = bmp ] && format="BMP3:"  # the classic header, as most programs write it
    convert -size "${w}x${h}" "gradient:$4-$5" \
        -fill '#ffffff' -draw "circle $((w / 2)),$((h / 2)) $((w / 2)),$((h / 5))" \
        -strip -define png:exclude-chunks=date,time "$format$file"
}
picture item-01.png 240 180 '#d8e8f8' '#3060a0'
picture item-02.png 120 200 '#f8e0d0' '#b04020'
picture item-03.png 64 64 '#e0f0d8' '#407030'
picture item-04.gif 200 150 '#f0f0c0' '#a08020'
picture item-05.gif 90 160 '#e8d8f0' '#603090'
picture item-06.gif 300 100 '#d0f0f0' '#208080'
picture item-07.bmp 160 120 '#f8d8e0' '#a02050'
picture item-08.bmp 100 100 '#e0e0e0' '#404040'
picture item-09.bmp 80 200 '#f0e8d0' '#806020'
picture item-10.jpg 320 240 '#d0d8f8' '#2040c0'
picture item-11.jpg 150 225 '#f8f0d0' '#c08000'
picture item-12.jpg 200 200 '#d8f8e0' '#209050'
picture logo.png 180 60 '#ffffff' '#3060a0'

sql_text() {  # a shell text as an SQL literal
    printf "'%s'" "${1//\'/\'\'}"
}
pictures_ref=$(sql_text "$refer_to/pictures/")

# --- the database
rm -f "$database" "$database-journal"
{
    echo "PRAGMA journal_mode = OFF;"
    echo "BEGIN;"
    cat "$here/accounting-schema.sql"
    cat <<SQL
CREATE TEMP TABLE Words (n INTEGER PRIMARY KEY, Hebrew TEXT, Latin TEXT);
INSERT INTO Words VALUES
 (0,'כיסא','Chair'),(1,'שולחן','Table'),(2,'מנורה','Lamp'),(3,'ארון','Cabinet'),(4,'מדף','Shelf'),
 (5,'ספה','Sofa'),(6,'כרית','Cushion'),(7,'שטיח','Rug'),(8,'מראה','Mirror'),(9,'וילון','Curtain'),
 (10,'קערה','Bowl'),(11,'צלחת','Plate'),(12,'כוס','Glass'),(13,'קומקום','Kettle'),(14,'מחבת','Pan'),
 (15,'סיר','Pot'),(16,'מגבת','Towel'),(17,'סל','Basket'),(18,'שעון','Clock'),(19,'אגרטל','Vase');
CREATE TEMP TABLE Kinds (n INTEGER PRIMARY KEY, Hebrew TEXT, Latin TEXT);
INSERT INTO Kinds VALUES
 (0,'עץ אלון','oak'),(1,'מתכת','metal'),(2,'זכוכית','glass'),(3,'קרמיקה','ceramic'),(4,'במבוק','bamboo'),
 (5,'פלסטיק','plastic'),(6,'פשתן','linen'),(7,'צמר','wool'),(8,'נחושת','copper'),(9,'שיש','marble');
CREATE TEMP TABLE Colours (n INTEGER PRIMARY KEY, Hebrew TEXT);
INSERT INTO Colours VALUES (0,'לבן'),(1,'שחור'),(2,'אדום'),(3,'כחול'),(4,'ירוק'),(5,'אפור'),(6,'חום');
CREATE TEMP TABLE Pictures (n INTEGER PRIMARY KEY, File TEXT);
INSERT INTO Pictures VALUES (0,'item-01.png'),(1,'item-02.png'),(2,'item-03.png'),(3,'item-04.gif'),
 (4,'item-05.gif'),(5,'item-06.gif'),(6,'item-07.bmp'),(7,'item-08.bmp'),(8,'item-09.bmp'),
 (9,'item-10.jpg'),(10,'item-11.jpg'),(11,'item-12.jpg');

-- The names of note kinds, price lists and sort groups, in no particular order of number.
INSERT INTO ExtraNoteNames VALUES
 (3,'תמונה נוספת',1),(1,'צבע',1),(2,'חומר',1),(4,'הערה לחשבונית',0),(5,'   ',1),(6,NULL,1),
 (7,'  ארץ ייצור  ',1),(8,'',1);
INSERT INTO PriceListNames VALUES
 (1,'מחירון סיטונאי','ש"ח'),(2,'מחירון קמעונאי','ש"ח'),(4,'   ','ש"ח'),(3,'Export prices','\$'),
 (5,NULL,'ש"ח'),(6,'מבצע חורף','ש"ח');
INSERT INTO ItemSortNames VALUES
 (1,'ריהוט לסלון'),(2,'ריהוט לחדר שינה'),(3,'תאורה'),(4,'כלי מטבח'),(5,'כלי הגשה'),(6,'טקסטיל'),
 (7,'Decor'),(8,'אחסון'),(9,'שטיחים'),(10,'שעונים'),(11,'אגרטלים'),(12,'מבצעים'),
 (13,NULL),(14,''),(5,'כלי הגשה (כפול)'),(NULL,'ללא קוד');
INSERT INTO Accounts VALUES
 ('10001','רהיטי הצפון בע"מ','חיפה'),('10002','Home Style Ltd.','Tel Aviv'),('10003','אור ונוף','ירושלים'),
 ('10004',NULL,'באר שבע');
SQL
    if [ -z "$items" ]; then
        cat <<SQL
-- The small demo: items 1 to 300 and a few on purpose.
CREATE TEMP TABLE Numbers AS
 WITH RECURSIVE n(i) AS (SELECT 1 UNION ALL SELECT i + 1 FROM n WHERE i < 300) SELECT i FROM n;
CREATE TEMP TABLE Demo AS SELECT i,
 CASE WHEN i % 10 = 0 THEN printf('%05d', i) ELSE substr('ABCDEFGH', 1 + i % 8, 1) || printf('%04d', i) END AS k
 FROM Numbers;
INSERT INTO Items SELECT k,
 CASE WHEN i % 53 = 0 THEN NULL WHEN i % 61 = 0 THEN '' WHEN i % 67 = 0 THEN '   '
      WHEN i % 7 = 0 THEN w.Latin || ' ' || d.Latin || ' ' || (10 + i % 90)
      ELSE w.Hebrew || ' ' || d.Hebrew || ' ' || (10 + i % 90) END,
 CASE WHEN i % 11 = 0 THEN NULL ELSE w.Latin || ' ' || d.Latin || ' ' || (10 + i % 90) END,
 CASE WHEN i % 29 = 0 THEN NULL ELSE 1 + i % 12 END,
 CASE WHEN i % 31 = 0 THEN NULL ELSE substr('ABCD', 1 + i % 4, 1) || substr('XYZ', 1 + i / 4 % 3, 1) || printf('%08d', i) END,
 CASE WHEN i % 37 = 0 THEN NULL ELSE CASE i % 5 WHEN 0 THEN 'יח''' WHEN 1 THEN 'ק"ג' WHEN 2 THEN 'מטר' WHEN 3 THEN 'זוג' ELSE 'סט' END END,
 CASE WHEN i % 41 = 0 THEN NULL ELSE round(9.9 + (i * 37) % 1000 + (i % 4) * 0.25, 2) END,
 CASE WHEN i % 43 = 0 THEN NULL WHEN i % 9 = 0 THEN '\$' ELSE 'ש"ח' END,
 CASE WHEN i % 5 = 4 THEN NULL WHEN i % 47 = 0 THEN $pictures_ref || 'missing-' || i || '.jpg'
      ELSE $pictures_ref || p.File END
 FROM Demo
 JOIN Words w ON w.n = i % 20 JOIN Kinds d ON d.n = i / 20 % 10 JOIN Pictures p ON p.n = i % 12;
INSERT INTO Items VALUES
 ('#','פריט כללי',NULL,1,NULL,'יח''',0,'ש"ח',NULL),
 ('*','פריט לשימוש פנימי',NULL,1,NULL,'יח''',0,'ש"ח',NULL),
 ('A0008','כיסא עץ אלון (רשומה כפולה)','Oak chair (second row)',1,'BX00000001','יח''',99,'ש"ח',NULL),
 (NULL,'פריט ללא מפתח',NULL,2,NULL,NULL,NULL,NULL,NULL),
 ('Z9999','Sample item without anything',NULL,NULL,NULL,NULL,NULL,NULL,NULL);
INSERT INTO PriceListsLastDateWithSub
 SELECT k, 1, round(0.8 * (9.9 + (i * 37) % 1000), 2), CASE WHEN i % 13 = 0 THEN NULL ELSE 'ש"ח' END, '2024-01-01' FROM Demo
 UNION ALL SELECT k, 2, CASE WHEN i % 17 = 0 THEN NULL ELSE round(1.1 * (9.9 + (i * 37) % 1000), 2) END, 'ש"ח', '2024-01-01' FROM Demo WHERE i % 2 = 0
 UNION ALL SELECT k, 3, round((9.9 + (i * 37) % 1000) / 3.7, 2), '\$', '2024-02-01' FROM Demo WHERE i % 3 = 0
 UNION ALL SELECT k, 6, round(0.7 * (9.9 + (i * 37) % 1000), 2), 'ש"ח', '2024-12-01' FROM Demo WHERE i % 10 = 0
 UNION ALL SELECT 'A0008', 1, 55.5, 'ש"ח', '2023-06-01';
INSERT INTO ExtraNotes
 SELECT 1, k, 1, c.Hebrew FROM Demo JOIN Colours c ON c.n = i % 7 WHERE i % 2 = 0
 UNION ALL SELECT 1, k, 2, d.Hebrew FROM Demo JOIN Kinds d ON d.n = i / 20 % 10 WHERE i % 3 <> 0
 UNION ALL SELECT 1, k, 3, $pictures_ref || p.File FROM Demo JOIN Pictures p ON p.n = (i + 5) % 12 WHERE i % 4 = 0
 UNION ALL SELECT 1, k, 7, CASE WHEN i % 2 = 0 THEN 'ישראל' ELSE 'איטליה' END FROM Demo WHERE i % 5 = 1
 UNION ALL SELECT 0, '10001', 4, 'לשלוח חשבונית בדואר'
 UNION ALL SELECT 1, 'A0008', 1, 'ירוק (הערה שנייה)'
 UNION ALL SELECT 1, 'B0009', 2, NULL;
SQL
    else
        cat <<SQL
-- $items uniform items, each with two prices and two notes.
CREATE TEMP TABLE Demo AS
 WITH RECURSIVE n(i) AS (SELECT 1 UNION ALL SELECT i + 1 FROM n WHERE i < $items)
 SELECT i, printf('K%07d', i) AS k FROM n;
INSERT INTO Items SELECT k,
 CASE WHEN i % 2 = 0 THEN w.Hebrew || ' ' || d.Hebrew || ' ' || i ELSE w.Latin || ' ' || d.Latin || ' ' || i END,
 w.Latin || ' ' || d.Latin || ' ' || i, 1 + i % 12,
 substr('ABCD', 1 + i % 4, 1) || substr('XYZ', 1 + i / 4 % 3, 1) || printf('%08d', i % 100000000),
 'יח''', round(9.9 + (i * 37) % 1000, 2), 'ש"ח', $pictures_ref || p.File
 FROM Demo JOIN Words w ON w.n = i % 20 JOIN Kinds d ON d.n = i / 20 % 10 JOIN Pictures p ON p.n = i % 12;
INSERT INTO PriceListsLastDateWithSub
 SELECT k, 1, round(0.8 * (9.9 + (i * 37) % 1000), 2), 'ש"ח', '2024-01-01' FROM Demo
 UNION ALL SELECT k, 2, round(1.1 * (9.9 + (i * 37) % 1000), 2), 'ש"ח', '2024-01-01' FROM Demo;
INSERT INTO ExtraNotes
 SELECT 1, k, 1, c.Hebrew FROM Demo JOIN Colours c ON c.n = i % 7
 UNION ALL SELECT 1, k, 2, d.Hebrew FROM Demo JOIN Kinds d ON d.n = i / 20 % 10;
SQL
    fi
    echo "COMMIT;"
} | sqlite3 -bail "$database" >/dev/null

# --- the settings of the demo catalog, in Qt's INI format (values quoted, UTF-8)
ini_value() {
    local value=${1//\\/\\\\}
    printf '"%s"' "${value//\"/\\\"}"
}
{
    echo "[Params]"
    while IFS='=' read -r key value; do
        [ -n "$key" ] && echo "$key=$(ini_value "$value")"
    done <<INI
ConnServer=$refer_to
ConnUID=
ConnPWD=
ConnDataBase=demo-accounting.db
ConnType=2
UseCatCode=0
FromSort=
ToSort=
UseFilter=0
CutOff1=*
CutOff2=*
CutOff3=*
CutOff4=*
CutOff5=*
UseItemKey=0
FromItem=
ToItem=
SortBy=0
SortDir=0
PicSource0=True
PicSource1=False
PicSource2=False
PicExtraNote=2
PicExtension=.jpg
PicPath=$refer_to/pictures/
ItemNameType=0
UsePriceField=1
UsePriceField2=0
PriceField=1
PriceField2=0
UseExtraNote1=0
UseExtraNote2=0
ExtraNote1=1
ExtraNote2=0
LineCaption0=
LineTag0=0
LineCaption1=
LineTag1=2
LineCaption2=פריט: 
LineTag2=1
LineCaption3=מחיר: 
LineTag3=4
Rows=3
Cols=3
PicLocation=0
PageSplit=1
Rules=1
TopTitle=קטלוג לדוגמה
TopTitle2=בית וגן בע"מ
BottomTitle=טלפון: 03-6123456
Logo=$refer_to/pictures/logo.png
PagingPath=
TopPercent=10
BottomPercent=10
ImageH=120
ImageW=120
Size0=9
Size1=12
Weight1=1
Align1=1
Size2=9
Align2=1
Size3=10
Weight3=1
Align3=1
INI
} > "$out/demo-settings.ini"
