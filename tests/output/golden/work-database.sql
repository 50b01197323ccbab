-- The working database of the golden cases: nine items (two left out of the catalog) whose
-- names, units, currencies and notes hold markup characters, Hebrew, an emoji, Chinese and
-- nulls. {root} is the folder of the cases; Include is -1 for true.
INSERT INTO tItems (ItemKey, ItemName, ItemSort, Unit, SellPrice, SellCoin, ItemPic, Include) VALUES
 ('1001', 'כיסא עץ', 10, 'יח''', 1234.5, 'ש"ח', '{root}/pictures/chair.png', -1),
 ('1002', 'שולחן אוכל', 10, 'יח''', 0.0, 'ש"ח', '{root}/pictures/table.gif', -1),
 ('1003', 'Bolt <M8> & nut', 20, 'pcs', -3.0, '$', '{root}/pictures/l''or & fils.jpg', -1),
 ('1004', 'מנורה 😀 Lamp', 30, '?', 99.999, '€', '?', -1),
 ('1005', NULL, NULL, NULL, NULL, NULL, NULL, -1),
 ('1006', '花瓶 vase', 30, 'kg', 1000000.0, '?', '{root}/pictures/wide.bmp', -1),
 ('1007', 'ספה "תלת" ''מושבית''', 40, 'יח''', 12.3, 'ש"ח', '{root}/pictures/missing.png', -1),
 ('1008', 'מוסתר', 10, 'יח''', 5.0, 'ש"ח', '?', 0),
 ('A-9', 'מוסתר גם הוא', 10, 'יח''', 6.0, 'ש"ח', '?', 0);
INSERT INTO tItemSort VALUES (10, 'ריהוט'), (20, 'ברגים & אומים'), (30, '<תאורה>');
INSERT INTO tItemPrice1 VALUES ('1001', '$', 330.0), ('1002', 'ש"ח', 2500.75);
INSERT INTO tItemPrice2 VALUES ('1001', '$', 300.25), ('1003', 'ש"ח', NULL), ('1006', NULL, 45.0);
INSERT INTO tExtraNote1 VALUES ('1001', 'עץ אלון'), ('1003', 'M8 <stainless>');
INSERT INTO tExtraNote2 VALUES ('1002', 'https://example.com/?a=1&b=2'), ('1006', '');
