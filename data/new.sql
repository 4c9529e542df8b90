-- The empty Veltrix database: the shared tables with their starting rows and the catalogue of
-- KPI fields. The build turns this file into new.db, the template every new main.db is copied
-- from.
--
-- Fields.Type: 1 heading, 2 summed from accounts (Data holds account codes joined by "+"),
-- 3 percentage with a benchmark (Data: "<" or ">" and the optimal, optionally "," and the
-- red limit), 4 count or hours, 5 computed money amount. The IDs are fixed: the KPI formulas
-- and the figures cache refer to them.

PRAGMA journal_mode = DELETE;

BEGIN;

CREATE TABLE Config (
  ID    INTEGER PRIMARY KEY,
  Value TEXT
);

CREATE TABLE Users (
  ID          INTEGER PRIMARY KEY AUTOINCREMENT,
  UserName    TEXT NOT NULL,
  Password    TEXT NOT NULL DEFAULT '',
  Type        INTEGER NOT NULL DEFAULT 0,
  DateCreated TEXT,
  Fields      TEXT NOT NULL DEFAULT '#'
);

CREATE TABLE Hours (
  ID         INTEGER PRIMARY KEY,
  Department TEXT NOT NULL DEFAULT '',
  Value      REAL
);

CREATE TABLE Fields (
  ID      INTEGER PRIMARY KEY,
  Tab     INTEGER NOT NULL,
  `Order` INTEGER NOT NULL,
  Hide    INTEGER NOT NULL DEFAULT 0,
  Type    INTEGER NOT NULL,
  Label   TEXT NOT NULL DEFAULT '',
  tooltip TEXT NOT NULL DEFAULT '',
  Data    TEXT NOT NULL DEFAULT ''
);

CREATE INDEX FieldsByTab ON Fields(Tab, `Order`);

-- 1 database version, 2 lowest program version allowed, 4 users logged in, 5 network request.
INSERT INTO Config (ID, Value) VALUES
  (1, '1.55'),
  (2, '1.55'),
  (4, '0'),
  (5, '');

-- Hourly rates in dollars; entered by an administrator before hours can be worked out.
INSERT INTO Hours (ID, Department, Value) VALUES
  (1, 'Panel', 0),
  (2, 'Paint', 0);

INSERT INTO Fields (ID, Tab, `Order`, Hide, Type, Label, tooltip, Data) VALUES
  (9, 1, 1010, 0, 1, 'Key performance indicators', '', ''),
  (1, 1, 1020, 0, 3, 'Panel labour gross profit %', 'Panel labour sales less panel wages, as a share of panel labour sales.', '>45,<35'),
  (2, 1, 1030, 0, 3, 'Paint labour gross profit %', 'Paint labour sales less paint wages, as a share of paint labour sales.', '>45,<35'),
  (3, 1, 1040, 0, 3, 'Panel net gross profit %', 'Panel labour gross profit after panel consumables, as a share of panel labour sales.', '>40,<30'),
  (4, 1, 1050, 0, 3, 'Paint net gross profit %', 'Paint labour gross profit after paint materials and sundries, as a share of paint labour sales.', '>30,<20'),
  (5, 1, 1060, 0, 3, 'Parts gross profit %', 'Parts sales less parts purchases, as a share of parts sales.', '>25,<18'),
  (6, 1, 1070, 0, 3, 'Parts share of repair sales %', 'Parts sales as a share of panel labour, paint labour, paint and materials and parts sales together.', '<45,>55'),
  (11, 1, 1080, 0, 3, 'Gross profit %', 'Total sales less total cost of sales, as a share of total sales.', '>35,<28'),
  (10, 1, 1090, 0, 1, 'Activity', '', ''),
  (7, 1, 1100, 0, 4, 'Repair orders invoiced', 'The number of repair orders invoiced in the period.', ''),
  (8, 1, 1110, 0, 5, 'Average repair order value', 'Total sales divided by the number of repair orders invoiced.', ''),
  (12, 2, 2010, 0, 1, 'Panel labour', '', ''),
  (13, 2, 2020, 0, 2, 'Panel labour sales', 'Labour charged for panel work in the period.', '4-1100'),
  (14, 2, 2030, 0, 2, 'Panel wages', 'Wages of the panel beaters for productive hours.', '5-1100'),
  (15, 2, 2040, 0, 5, 'Panel labour gross profit', 'Panel labour sales less panel wages.', ''),
  (16, 2, 2050, 0, 3, 'Panel labour gross profit %', 'Panel labour gross profit as a share of panel labour sales.', '>45,<35'),
  (17, 2, 2060, 0, 2, 'Panel consumables', 'Fillers, abrasives, fasteners and other consumables used in panel work.', '5-1300'),
  (18, 2, 2070, 0, 5, 'Panel net gross profit', 'Panel labour gross profit less panel consumables.', ''),
  (19, 2, 2080, 0, 3, 'Panel net gross profit %', 'Panel net gross profit as a share of panel labour sales.', '>40,<30'),
  (62, 2, 2090, 0, 4, 'Panel hours sold', 'Panel labour sales divided by the panel hourly rate.', ''),
  (70, 2, 2100, 0, 5, 'Panel consumables per panel hour', 'Panel consumables divided by the panel hours sold.', ''),
  (20, 2, 2110, 0, 1, 'Paint labour', '', ''),
  (21, 2, 2120, 0, 2, 'Paint labour sales', 'Labour charged for paint work in the period.', '4-1200'),
  (22, 2, 2130, 0, 2, 'Paint wages', 'Wages of the painters and preparers for productive hours.', '5-1200'),
  (23, 2, 2140, 0, 5, 'Paint labour gross profit', 'Paint labour sales less paint wages.', ''),
  (24, 2, 2150, 0, 3, 'Paint labour gross profit %', 'Paint labour gross profit as a share of paint labour sales.', '>45,<35'),
  (25, 2, 2160, 0, 2, 'Paint materials used', 'Paint and clear coat used on jobs in the period.', '5-2100'),
  (26, 2, 2170, 0, 2, 'Paint sundries used', 'Masking, thinners, abrasives and other paint shop sundries used in the period.', '5-2200'),
  (27, 2, 2180, 0, 5, 'Paint net gross profit', 'Paint labour gross profit less paint materials and sundries.', ''),
  (28, 2, 2190, 0, 3, 'Paint net gross profit %', 'Paint net gross profit as a share of paint labour sales.', '>30,<20'),
  (63, 2, 2200, 0, 4, 'Paint hours sold', 'Paint labour sales divided by the paint hourly rate.', ''),
  (68, 2, 2210, 0, 5, 'Paint materials per paint hour', 'Paint materials used divided by the paint hours sold.', ''),
  (69, 2, 2220, 0, 5, 'Paint sundries per paint hour', 'Paint sundries used divided by the paint hours sold.', ''),
  (98, 2, 2230, 0, 5, 'Materials and sundries per paint hour', 'Paint materials and sundries together, per paint hour sold, shown as a cost.', ''),
  (29, 2, 2240, 0, 1, 'All labour', '', ''),
  (30, 2, 2250, 0, 5, 'Total labour sales', 'Panel and paint labour sales together.', ''),
  (31, 2, 2260, 0, 5, 'Total labour gross profit', 'Panel and paint labour gross profit together.', ''),
  (32, 2, 2270, 0, 3, 'Average labour gross profit %', 'The mean of the panel and paint labour gross profit percentages.', '>45,<35'),
  (33, 2, 2280, 0, 5, 'Total labour net gross profit', 'Total labour gross profit less panel consumables, paint materials and paint sundries.', ''),
  (34, 2, 2290, 0, 3, 'Average net gross profit %', 'The mean of the panel and paint net gross profit percentages.', '>35,<25'),
  (64, 2, 2300, 0, 4, 'Total hours sold', 'Panel and paint hours sold together.', ''),
  (127, 2, 2310, 0, 5, 'Wages per hour sold', 'Panel and paint wages divided by the total hours sold.', ''),
  (44, 3, 3010, 0, 1, 'Parts', '', ''),
  (35, 3, 3020, 0, 2, 'Parts sales', 'Parts charged to customers and insurers in the period.', '4-1400'),
  (36, 3, 3030, 0, 2, 'Parts purchases', 'Parts bought for jobs in the period.', '5-1400'),
  (37, 3, 3040, 0, 5, 'Parts gross profit', 'Parts sales less parts purchases.', ''),
  (38, 3, 3050, 0, 3, 'Parts gross profit %', 'Parts gross profit as a share of parts sales.', '>25,<18'),
  (42, 3, 3060, 0, 3, 'Parts sales % of total sales', 'Parts sales as a share of total sales.', '<45,>55'),
  (41, 3, 3070, 0, 3, 'Parts share of repair sales %', 'Parts sales as a share of panel labour, paint labour, paint and materials and parts sales together.', '<45,>55'),
  (48, 4, 4010, 0, 1, 'Paint and materials', '', ''),
  (43, 4, 4020, 0, 2, 'Paint and materials sales', 'Paint and materials charged to customers and insurers in the period.', '4-1300'),
  (45, 4, 4030, 0, 2, 'Paint purchases', 'Paint and clear coat bought in the period.', '5-2100'),
  (46, 4, 4040, 0, 3, 'Paint purchases % of paint and materials sales', 'Paint purchases as a share of paint and materials sales.', '<50,>60'),
  (47, 4, 4050, 0, 3, 'Paint purchases % of total sales', 'Paint purchases as a share of total sales.', '<5,>7'),
  (49, 4, 4060, 0, 2, 'Paint sundries purchases', 'Masking, thinners, abrasives and other paint shop sundries bought in the period.', '5-2200'),
  (50, 4, 4070, 0, 3, 'Sundries % of paint and materials sales', 'Paint sundries purchases as a share of paint and materials sales.', '<20,>28'),
  (51, 4, 4080, 0, 3, 'Sundries % of total sales', 'Paint sundries purchases as a share of total sales.', '<1.5,>2.5'),
  (53, 4, 4090, 0, 5, 'Paint and sundries purchases', 'Paint purchases and paint sundries purchases together.', ''),
  (54, 4, 4100, 0, 3, 'Paint and sundries % of paint and materials sales', 'Paint and sundries purchases as a share of paint and materials sales.', '<65,>75'),
  (55, 4, 4110, 0, 3, 'Paint and sundries % of total sales', 'Paint and sundries purchases as a share of total sales.', '<6,>8'),
  (117, 4, 4120, 0, 2, 'Paint booth running costs', 'Gas, power and filters for the spray booth in the period.', '5-2300'),
  (115, 4, 4130, 0, 3, 'Booth running costs % of paint and materials sales', 'Paint booth running costs as a share of paint and materials sales.', '<8,>12'),
  (116, 4, 4140, 0, 3, 'Booth running costs % of total sales', 'Paint booth running costs as a share of total sales.', '<0.5,>1'),
  (113, 4, 4150, 0, 5, 'Booth running costs per paint hour', 'Paint booth running costs divided by the paint hours sold.', ''),
  (52, 5, 5010, 0, 1, 'Repair orders', '', ''),
  (97, 5, 5020, 0, 4, 'Repair orders invoiced', 'The number of repair orders invoiced in the period.', ''),
  (96, 5, 5030, 0, 4, 'Working days', 'Monday to Friday days in the period.', ''),
  (94, 5, 5040, 0, 4, 'Repair orders per working day', 'Repair orders invoiced divided by the working days.', ''),
  (56, 5, 5050, 0, 4, 'Repair orders per week', 'Repair orders invoiced divided by the weeks in the period.', ''),
  (124, 5, 5060, 0, 5, 'Average repair order value', 'Total sales divided by the number of repair orders invoiced.', ''),
  (125, 5, 5070, 0, 5, 'Overheads per repair order', 'Total overheads divided by the number of repair orders invoiced.', ''),
  (126, 5, 5080, 0, 5, 'Net profit per repair order', 'Net profit divided by the number of repair orders invoiced.', ''),
  (61, 5, 5090, 0, 1, 'Per repair order', '', ''),
  (57, 5, 5100, 0, 5, 'Labour sales per repair order', 'Panel and paint labour sales divided by the repair orders invoiced.', ''),
  (58, 5, 5110, 0, 5, 'Wages per repair order', 'Panel and paint wages divided by the repair orders invoiced.', ''),
  (59, 5, 5120, 0, 5, 'Labour gross profit per repair order', 'Labour sales less wages, per repair order.', ''),
  (60, 5, 5130, 0, 3, 'Labour gross profit % per repair order', 'Labour gross profit per repair order as a share of labour sales per repair order.', '>45,<35'),
  (65, 5, 5140, 0, 4, 'Panel hours per repair order', 'Panel hours sold divided by the repair orders invoiced.', ''),
  (66, 5, 5150, 0, 4, 'Paint hours per repair order', 'Paint hours sold divided by the repair orders invoiced.', ''),
  (67, 5, 5160, 0, 4, 'Total hours per repair order', 'Total hours sold divided by the repair orders invoiced.', ''),
  (39, 5, 5170, 0, 5, 'Parts sales per repair order', 'Parts sales divided by the repair orders invoiced.', ''),
  (40, 5, 5180, 0, 5, 'Parts purchases per repair order', 'Parts purchases divided by the repair orders invoiced.', ''),
  (93, 5, 5190, 0, 5, 'Parts gross profit per repair order', 'Parts gross profit divided by the repair orders invoiced.', ''),
  (71, 6, 6010, 0, 1, 'Sales', '', ''),
  (72, 6, 6020, 0, 2, 'Panel labour', 'Panel labour income account.', '4-1100'),
  (73, 6, 6030, 0, 2, 'Paint labour', 'Paint labour income account.', '4-1200'),
  (74, 6, 6040, 0, 2, 'Paint and materials', 'Paint and materials income account.', '4-1300'),
  (75, 6, 6050, 0, 2, 'Parts', 'Parts income account.', '4-1400'),
  (76, 6, 6060, 0, 2, 'Sublet repairs', 'Work sent out to other repairers and charged on.', '4-1500'),
  (77, 6, 6070, 0, 2, 'Towing and storage', 'Towing and vehicle storage charged to customers.', '4-1600'),
  (78, 6, 6080, 0, 2, 'Other workshop income', 'Workshop income that fits no other account.', '4-1700'),
  (118, 6, 6090, 0, 2, 'Discounts allowed', 'Discounts and excess reductions given on invoices.', '4-1900'),
  (79, 6, 6100, 0, 5, 'Total sales', 'All income accounts together; the base of most percentages.', ''),
  (80, 6, 6110, 0, 1, 'Cost of sales', '', ''),
  (81, 6, 6120, 0, 2, 'Panel wages', 'Productive wages of the panel beaters.', '5-1100'),
  (82, 6, 6130, 0, 2, 'Paint wages', 'Productive wages of the painters and preparers.', '5-1200'),
  (83, 6, 6140, 0, 2, 'Panel consumables', 'Consumables used in panel work.', '5-1300'),
  (84, 6, 6150, 0, 2, 'Parts purchases', 'Parts bought for jobs.', '5-1400'),
  (85, 6, 6160, 0, 2, 'Paint purchases', 'Paint and clear coat bought.', '5-2100'),
  (86, 6, 6170, 0, 2, 'Paint sundries', 'Paint shop sundries bought.', '5-2200'),
  (87, 6, 6180, 0, 2, 'Sublet costs', 'What other repairers charged for sublet work.', '5-3100'),
  (88, 6, 6190, 0, 2, 'Towing and freight', 'Towing costs and freight on parts.', '5-3200+5-3300'),
  (99, 6, 6200, 0, 2, 'Stock adjustments', 'Stocktake adjustments of parts and paint.', '5-3900'),
  (119, 6, 6210, 0, 2, 'Warranty, rework and courtesy cars', 'Redone work and courtesy car costs.', '5-4100+5-4200'),
  (120, 6, 6220, 0, 2, 'Paint booth running costs', 'Gas, power and filters for the spray booth.', '5-2300'),
  (89, 6, 6230, 0, 5, 'Total cost of sales', 'All cost of sales accounts together.', ''),
  (91, 6, 6240, 0, 1, 'Gross profit', '', ''),
  (90, 6, 6250, 0, 5, 'Gross profit', 'Total sales less total cost of sales.', ''),
  (92, 6, 6260, 0, 3, 'Gross profit %', 'Gross profit as a share of total sales.', '>35,<28'),
  (104, 6, 6270, 0, 3, 'Panel wages % of sales', 'Panel wages as a share of total sales.', '<16,>20'),
  (105, 6, 6280, 0, 3, 'Paint wages % of sales', 'Paint wages as a share of total sales.', '<9,>12'),
  (106, 6, 6290, 0, 3, 'Cost of sales % of sales', 'Total cost of sales as a share of total sales.', '<65,>72'),
  (95, 6, 6300, 0, 1, 'Overheads', '', ''),
  (101, 6, 6310, 0, 2, 'Staff overheads', 'Office wages, superannuation and workers compensation.', '6-1000+6-1100+6-1200'),
  (102, 6, 6320, 0, 2, 'Other overheads', 'Rent, power, insurance, advertising, vehicles, phones, accounting and sundries.', '6-2000+6-3000+6-4000+6-5000+6-6000+6-7000+6-8000+6-9000'),
  (103, 6, 6330, 0, 5, 'Total overheads', 'Staff and other overheads together.', ''),
  (107, 6, 6340, 0, 3, 'Staff overheads % of sales', 'Staff overheads as a share of total sales.', '<8,>11'),
  (108, 6, 6350, 0, 3, 'Other overheads % of sales', 'Other overheads as a share of total sales.', '<12,>16'),
  (109, 6, 6360, 0, 3, 'Total overheads % of sales', 'Total overheads as a share of total sales.', '<20,>26'),
  (100, 6, 6370, 0, 1, 'Net profit', '', ''),
  (110, 6, 6380, 0, 5, 'Net profit', 'Gross profit less total overheads.', ''),
  (111, 6, 6390, 0, 3, 'Net profit %', 'Net profit as a share of total sales.', '>8,<4'),
  (112, 6, 6400, 0, 5, 'Net profit per working day', 'Net profit divided by the working days in the period.', '');

COMMIT;
