-- Tables of the suite's server databases that the filing add-in reads or writes, for
-- Microsoft SQL Server (kept in step with postgres.sql). Each section goes into the
-- database named by its marker followed by the installation's client number.
--
-- Format as in sqlite.sql: a line "-- database: NAME" opens a section, statements end with
-- ";" at the end of a line. Text columns use the server's default case-insensitive
-- collation; Booleans are bit.

-- database: OFFICE
CREATE TABLE MTIK (
    ID int NOT NULL PRIMARY KEY,
    TEUR nvarchar(255) NULL,
    SHOW bit NULL DEFAULT 0
);
CREATE TABLE OFF_CODE (
    CODE int NOT NULL,
    NUM int NOT NULL,
    Teur nvarchar(255) NULL,
    PRIMARY KEY (CODE, NUM)
);
CREATE TABLE CLIENT (
    NUM nvarchar(50) NOT NULL PRIMARY KEY,
    F_NAME nvarchar(100) NULL,
    L_NAME nvarchar(100) NULL,
    TELEFON nvarchar(50) NULL
);
CREATE INDEX CLIENT_L_NAME ON CLIENT (L_NAME);
CREATE INDEX CLIENT_F_NAME ON CLIENT (F_NAME);

-- database: MDOCS
-- The server assigns ID.
CREATE TABLE DOCS (
    ID int IDENTITY(1,1) NOT NULL PRIMARY KEY,
    IsMemo bit NULL DEFAULT 1,
    DateCreated datetime NULL,
    FULLNAME nvarchar(450) NULL,
    ShortName nvarchar(255) NULL,
    DirPath nvarchar(450) NULL,
    DirMone smallint NULL DEFAULT 0,
    Metapel nvarchar(255) NULL,
    Teur nvarchar(255) NULL,
    SecTeur nvarchar(255) NULL,
    MemoDate datetime NULL,
    MemoHour nvarchar(10) NULL,
    IsJumpMemo bit NULL DEFAULT 0,
    RecieveDate datetime NULL,
    LastModificationTime datetime NULL,
    LastModificationUser nvarchar(100) NULL,
    Body nvarchar(max) NULL,
    PARTOF int NULL DEFAULT 0,
    Status int NULL DEFAULT 0,
    Source smallint NULL DEFAULT 0,
    CLIENT_NUM nvarchar(50) NULL,
    SUG nvarchar(10) NULL,
    IDTik smallint NULL DEFAULT 0,
    TIK nvarchar(50) NULL,
    NUM nvarchar(50) NULL
);
CREATE INDEX DOCS_FULLNAME ON DOCS (FULLNAME);
CREATE TABLE DOCSTATUS (
    ID int NOT NULL PRIMARY KEY,
    Caption nvarchar(255) NULL,
    ORD int NULL
);

-- database: BM
CREATE TABLE UMEMO (
    MemoNum int IDENTITY(1,1) NOT NULL PRIMARY KEY,
    USER97 nvarchar(50) NULL,
    METAPEL nvarchar(100) NULL,
    MTYPE smallint NULL,
    RTYPE smallint NULL,
    ID int NULL,
    MEMOTIME datetime NULL,
    DateUpdated datetime NULL
);
CREATE INDEX UMEMO_ID_MTYPE ON UMEMO (ID, MTYPE);
CREATE UNIQUE INDEX UMEMO_ENTRY ON UMEMO (ID, MTYPE, USER97, METAPEL);

-- database: ZORVA
CREATE TABLE LOOKFOR (
    LookForID int IDENTITY(1,1) NOT NULL PRIMARY KEY,
    LakNum nvarchar(50) NULL,
    OptKey int NOT NULL DEFAULT 0,
    Sug nvarchar(10) NULL,
    Tik nvarchar(50) NULL,
    Code nvarchar(50) NULL,
    TIK_ID nvarchar(20) NULL,
    F_NAME nvarchar(100) NULL,
    L_NAME nvarchar(100) NULL,
    TELEFON nvarchar(50) NULL
);
CREATE INDEX LOOKFOR_CLIENT ON LOOKFOR (LakNum, OptKey, Tik);
CREATE INDEX LOOKFOR_KIND ON LOOKFOR (OptKey, LakNum);
CREATE INDEX LOOKFOR_L_NAME ON LOOKFOR (L_NAME);
