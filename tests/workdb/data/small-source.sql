-- A small accounting database with a case for every rule of the collection, in the order the
-- source returns the rows (CollectionTest; the expected working tables: small-collected.txt).
INSERT INTO Items VALUES
    ('A100','כיסא אלון','Oak chair',1,'AX00000001','יח''',10.5,'ש"ח','/pics/a100.png'),
    ('a200',NULL,'Lamp',NULL,NULL,NULL,NULL,NULL,NULL),
    ('ab','first ab',NULL,2,'BX','סט',3,'$','/pics/ab.png'),
    ('AB','second AB',NULL,3,'CX','סט',4,'$','/pics/AB2.png'),
    ('#','general',NULL,1,NULL,NULL,0,NULL,NULL),
    ('*','internal',NULL,1,NULL,NULL,0,NULL,NULL),
    (NULL,'no key',NULL,1,NULL,NULL,0,NULL,NULL),
    ('','empty key',NULL,1,NULL,NULL,0,NULL,NULL),
    ('B300','first B300',NULL,4,NULL,'זוג',5,'ש"ח',''),
    ('B300','second B300',NULL,5,NULL,'זוג',6,'ש"ח',NULL),
    ('C400','מנורה',NULL,6,NULL,'סט',7,'ש"ח',NULL),
    ('D500','ספה',NULL,7,NULL,'סט',8,'ש"ח',NULL),
    ('E600','שטיח',NULL,8,NULL,'סט',9,'ש"ח',NULL),
    ('ך1','final',NULL,9,NULL,'סט',1,'ש"ח',NULL),
    ('כ1','normal',NULL,9,NULL,'סט',2,'ש"ח',NULL);
INSERT INTO PriceListsLastDateWithSub VALUES
    ('A100',1,9.5,NULL,''),('a200',1,NULL,'$',''),('A100',1,8,'$',''),('#',1,1,'$',''),
    ('ab',2,7,'$',''),('AB',2,70,'$',''),('D500',2,7.5,'$','');
INSERT INTO ExtraNotes VALUES
    (1,'A100',1,'אדום'),(1,'A100',1,'שני'),(1,'a200',1,NULL),(0,'A100',2,'not an item note'),
    (1,'ab',2,'/pics/note-ab.png'),(1,'C400',2,'/pics/note-c.png'),(1,'*',2,'star');
INSERT INTO ItemSortNames VALUES
    (1,'סלון'),(2,NULL),(3,''),(1,'כפול'),(NULL,'ללא קוד'),(40,'מחוץ לטווח');
