-- Reference sets for SQL Server: a table, the procedure that the library calls, and two sets to begin with.
-- Run it in the workshop's database; a second run leaves rows that are there as they are. It needs SQL Server 2008 or later.

SET NOCOUNT ON;
GO

IF OBJECT_ID('dbo.VarnexReferenceSet', 'U') IS NULL
    CREATE TABLE dbo.VarnexReferenceSet
    (
        Name        varchar(50)   NOT NULL,
        Code        varchar(20)   NOT NULL,
        Description nvarchar(255) NOT NULL,
        CONSTRAINT PK_VarnexReferenceSet PRIMARY KEY (Name, Code)
    );
GO

IF OBJECT_ID('dbo.getVarnexReferenceSet', 'P') IS NOT NULL
    DROP PROCEDURE dbo.getVarnexReferenceSet;
GO

-- The rows of the set @Name: all of them, or with a @Filter that is not empty the one with that code. A set that does
-- not exist has no rows. The order of the parameters matters: texts are given to inputs by their place.
CREATE PROCEDURE dbo.getVarnexReferenceSet
    @Name   varchar(50),
    @Filter varchar(50),
    @ID     int          OUTPUT,
    @ErrNo  int          OUTPUT,
    @ErrMsg varchar(255) OUTPUT
AS
BEGIN
    SET NOCOUNT ON;
    SELECT @ID = 0, @ErrNo = 0, @ErrMsg = NULL;

    SELECT Code, Description
    FROM dbo.VarnexReferenceSet
    WHERE Name = @Name AND (@Filter = '' OR Code = @Filter)
    ORDER BY Code;
END;
GO

INSERT INTO dbo.VarnexReferenceSet (Name, Code, Description)
SELECT New.Name, New.Code, New.Description
FROM (VALUES
    ('REPAIRMODELTYPE', 'A',  N'Assessed'),
    ('REPAIRMODELTYPE', 'CP', N'Allocated'),
    ('REPAIRMODELTYPE', 'T',  N'Tendering'),
    ('ERRORSEVERITY',   'E',  N'Error'),
    ('ERRORSEVERITY',   'F',  N'Fatal'),
    ('ERRORSEVERITY',   'I',  N'Information'),
    ('ERRORSEVERITY',   'W',  N'Warning')
) AS New (Name, Code, Description)
WHERE NOT EXISTS (SELECT * FROM dbo.VarnexReferenceSet AS Old WHERE Old.Name = New.Name AND Old.Code = New.Code);
GO
