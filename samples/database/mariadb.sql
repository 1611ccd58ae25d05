-- Reference sets for MariaDB: a table, the procedure that the library calls, and two sets to begin with.
-- Run it in the workshop's database; a second run leaves rows that are there as they are.

CREATE TABLE IF NOT EXISTS VarnexReferenceSet
(
    Name        varchar(50)  NOT NULL,
    Code        varchar(20)  NOT NULL,
    Description varchar(255) NOT NULL,
    PRIMARY KEY (Name, Code)
) DEFAULT CHARACTER SET utf8mb4;

-- The rows of the set @Name: all of them, or with a @Filter that is not empty the one with that code. A set that does
-- not exist has no rows. The order of the parameters matters: texts are given to inputs by their place.
DELIMITER //
CREATE OR REPLACE PROCEDURE getVarnexReferenceSet
(
    IN  `@Name`   varchar(50),
    IN  `@Filter` varchar(50),
    OUT `@ID`     int,
    OUT `@ErrNo`  int,
    OUT `@ErrMsg` varchar(255)
)
READS SQL DATA
BEGIN
    SET `@ID` = 0, `@ErrNo` = 0, `@ErrMsg` = NULL;

    SELECT Code, Description
    FROM VarnexReferenceSet
    WHERE Name = `@Name` AND (`@Filter` = '' OR Code = `@Filter`)
    ORDER BY Code;
END //
DELIMITER ;

INSERT IGNORE INTO VarnexReferenceSet (Name, Code, Description) VALUES
    ('REPAIRMODELTYPE', 'A',  'Assessed'),
    ('REPAIRMODELTYPE', 'CP', 'Allocated'),
    ('REPAIRMODELTYPE', 'T',  'Tendering'),
    ('ERRORSEVERITY',   'E',  'Error'),
    ('ERRORSEVERITY',   'F',  'Fatal'),
    ('ERRORSEVERITY',   'I',  'Information'),
    ('ERRORSEVERITY',   'W',  'Warning');
