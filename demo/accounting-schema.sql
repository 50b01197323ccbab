-- The tables of the accounting database that the catalog reads, with the columns it uses (and a
-- few it does not, as a real company database has). Plain SQL that SQLite and PostgreSQL both
-- accept: the demo database and the PostgreSQL test server are built from this one file.
CREATE TABLE Items (
    ItemKey VARCHAR(20),
    ItemName VARCHAR(100),
    ForignName VARCHAR(100),
    SortGroup INTEGER,
    Filter VARCHAR(10),
    SalesUnit VARCHAR(5),
    Price DOUBLE PRECISION,
    Currency VARCHAR(5),
    ExFile VARCHAR(250)
);
CREATE INDEX ItemsByKey ON Items (ItemKey);

CREATE TABLE ExtraNotes (
    ItemFlag INTEGER,
    KeF VARCHAR(20),
    NoteID INTEGER,
    Note VARCHAR(250)
);
CREATE INDEX ExtraNotesByOwner ON ExtraNotes (KeF, NoteID);

CREATE TABLE ExtraNoteNames (
    NoteID INTEGER,
    NoteName VARCHAR(50),
    ItemFlag INTEGER
);

CREATE TABLE PriceListNames (
    PriceListID INTEGER,
    PriceListName VARCHAR(50),
    CurrencyCode VARCHAR(5)
);

CREATE TABLE PriceListsLastDateWithSub (
    ItemKey VARCHAR(20),
    PriceListNumber INTEGER,
    Price DOUBLE PRECISION,
    CurrencyCode VARCHAR(5),
    PriceDate VARCHAR(10)
);
CREATE INDEX PricesByItem ON PriceListsLastDateWithSub (ItemKey, PriceListNumber);

CREATE TABLE ItemSortNames (
    ItemSortCode INTEGER,
    SortCodeName VARCHAR(50)
);

CREATE TABLE Accounts (
    AccountKey VARCHAR(15),
    FullName VARCHAR(50),
    City VARCHAR(30)
);
