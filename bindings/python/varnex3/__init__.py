"""The object model of the Xalo message language.

    import varnex3
    from datetime import datetime

    source = varnex3.SourceDef()
    source.OrgType = "REP"
    source.TimeStamp = datetime(2004, 3, 15, 14, 5, 9)
    print(source.Serialise())

Classes, properties and methods have the names they have in every language. Dates are datetime (local, without a
zone), enumerations IntEnum, absent objects None. An indexed property is read by calling it, record.Values("Phone"), and
stored with record.put("Values", "Phone", value). A method that brings results back in its arguments returns a tuple:
ok, number, message = varnex3.Xalo_Messages().ParseFiles(folder). What the library raises is varnex3.Error.

Records may be used from several threads, but one record by one thread at a time.
"""

from ._classes import CLASSES, ENUMERATIONS, MODULES, RECORDS, Record
from ._library import Error, decode, library

__version__ = decode(library.varnex3_version())

globals().update(RECORDS)
globals().update(ENUMERATIONS)
globals().update(MODULES)
for _module in MODULES.values():
    globals().update({_name: getattr(_module, _name) for _name in vars(_module) if not _name.startswith("_")})
del _module

__all__ = ["CLASSES", "Error", "Record", *RECORDS, *ENUMERATIONS, *MODULES]
