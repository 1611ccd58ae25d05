/* Varnex3 for C, and for every language that can call C.
 *
 * Records are opaque handles, values are tagged, classes and members are reached by the names they have everywhere.
 * Texts are UTF-8 with a length; a lone surrogate, which a record may hold, travels in its three-byte form.
 *
 *     varnex3_record* source = NULL;
 *     varnex3_value value = {VARNEX3_TEXT, 0, 0, "REP", 3, NULL};
 *     if (varnex3_create("SourceDef", &source) != 0 || varnex3_put(source, "OrgType", &value) != 0)
 *         fprintf(stderr, "%s\n", varnex3_error_description());
 *     varnex3_release(source);
 *
 * Every function that can fail returns 0, or the number of the error; varnex3_error_number, _source and _description
 * then tell of it, on the same thread. Numbers below 30000 are the classic automation numbers (13 type mismatch, 438
 * no such member), those from 30000 on the library's own.
 *
 * A handle, and what it leads to, is used by one thread at a time; different records may be used by different threads.
 */
#ifndef VARNEX3_C_H
#define VARNEX3_C_H

#include <stddef.h>
#include <stdint.h>

#ifdef __cplusplus
extern "C" {
#endif

#if defined(_WIN32) && defined(VARNEX3_EXPORTS) /* when Varnex3.dll itself is compiled */
#define VARNEX3_API __declspec(dllexport)
#elif defined(_WIN32)
#define VARNEX3_API __declspec(dllimport)
#else
#define VARNEX3_API __attribute__((visibility("default")))
#endif

/* One record, by a reference that its holder releases. */
typedef struct varnex3_record varnex3_record;

/* What a value is, and what a member takes and gives. */
typedef enum varnex3_kind
{
    VARNEX3_EMPTY = 0,   /* nothing: converts to "", 0, the zero date and false; of a member: it gives nothing */
    VARNEX3_TEXT = 1,    /* text, length */
    VARNEX3_DOUBLE = 2,  /* number */
    VARNEX3_DATE = 3,    /* number: days since 30 December 1899, the fraction is the time of day */
    VARNEX3_INT16 = 4,   /* integer */
    VARNEX3_INT32 = 5,   /* integer */
    VARNEX3_BOOLEAN = 6, /* integer: 0 or 1 */
    VARNEX3_OBJECT = 7,  /* record; null for nothing */
    VARNEX3_ENUM = 8,    /* of a member: its values are VARNEX3_INT32 */
    VARNEX3_VARIANT = 9  /* of a member: its values are of any kind */
} varnex3_kind;

/* A value. What the library gives is the caller's to clear; what it is given stays the caller's and is copied. */
typedef struct varnex3_value
{
    int32_t kind;     /* a varnex3_kind */
    int32_t integer;  /* integers and Booleans */
    double number;    /* doubles and dates */
    const char* text; /* UTF-8; what the library gives ends with a NUL */
    size_t length;    /* of the text, in bytes, without that NUL */
    varnex3_record* record;
} varnex3_value;

/* A class, or a module: functions that need no record. */
typedef struct varnex3_class
{
    const char* name;
    const char* doc;
    int32_t is_module;
    int32_t member_count;
} varnex3_class;

/* A method or property of a class, in interface order. */
typedef struct varnex3_member
{
    const char* name;
    const char* doc;
    int32_t is_property;     /* 0: a method */
    int32_t is_writable;     /* of a property */
    int32_t kind;            /* a varnex3_kind: of the property, or of the method's result */
    const char* type_name;   /* of an enumeration or a class; "" otherwise */
    int32_t parameter_count; /* of a property: how many indexes it takes */
} varnex3_member;

typedef struct varnex3_parameter
{
    const char* name;
    int32_t kind;
    const char* type_name;
    int32_t is_optional;
    const char* initial;     /* the text that an omitted argument has; "" otherwise */
    int32_t is_by_reference; /* hosts of other kinds pass a variable */
    int32_t is_output;       /* the argument holds a result after the call */
} varnex3_parameter;

typedef struct varnex3_enumeration
{
    const char* name;
    const char* doc;
    int32_t constant_count;
} varnex3_enumeration;

typedef struct varnex3_constant
{
    const char* name;
    const char* doc;
    int32_t value;
} varnex3_constant;

/* The library's version, such as "3.0.0". */
VARNEX3_API const char* varnex3_version(void);

/* ---- what there is; the names and words given are never freed ---- */

/* The number of classes and modules. */
VARNEX3_API int32_t varnex3_class_count(void);
/* The class at a position from 0; 9 out of range. */
VARNEX3_API int32_t varnex3_class_at(int32_t position, varnex3_class* result);
/* The member of a class at a position from 0; 429 for an unknown class, 9 out of range. */
VARNEX3_API int32_t varnex3_member_at(const char* class_name, int32_t position, varnex3_member* result);
/* A parameter of a member, both at positions from 0; 429 for an unknown class, 9 out of range. */
VARNEX3_API int32_t varnex3_parameter_at(const char* class_name, int32_t member, int32_t position,
                                         varnex3_parameter* result);
/* The number of enumerations. */
VARNEX3_API int32_t varnex3_enumeration_count(void);
/* The enumeration at a position from 0; 9 out of range. */
VARNEX3_API int32_t varnex3_enumeration_at(int32_t position, varnex3_enumeration* result);
/* A constant of an enumeration, both at positions from 0; 9 out of range. */
VARNEX3_API int32_t varnex3_constant_at(int32_t enumeration, int32_t position, varnex3_constant* result);
/* The value of a constant by name, such as "CustomerTypeEnum", "Company"; 5 for an unknown name. */
VARNEX3_API int32_t varnex3_constant_value(const char* enumeration, const char* constant, int32_t* result);

/* ---- records ---- */

/* A new record of a class, such as "VehicleDef"; 429 for an unknown class or a module. */
VARNEX3_API int32_t varnex3_create(const char* class_name, varnex3_record** result);
/* One more reference to a record. */
VARNEX3_API void varnex3_add_ref(varnex3_record* record);
/* One reference less; with the last one the record ends. Null is fine. */
VARNEX3_API void varnex3_release(varnex3_record* record);
/* The name of the record's class; never freed. */
VARNEX3_API const char* varnex3_class_of(const varnex3_record* record);

/* Reads a property; 438 when there is none of this name. */
VARNEX3_API int32_t varnex3_get(varnex3_record* record, const char* property, varnex3_value* result);
/* Reads an indexed property, such as Values. */
VARNEX3_API int32_t varnex3_get_indexed(varnex3_record* record, const char* property, const varnex3_value* indexes,
                                        int32_t index_count, varnex3_value* result);
/* Stores a property; the value is converted where it can be (13, 6 where not); 383 when the property is read-only. */
VARNEX3_API int32_t varnex3_put(varnex3_record* record, const char* property, const varnex3_value* value);
/* Stores an indexed property. */
VARNEX3_API int32_t varnex3_put_indexed(varnex3_record* record, const char* property, const varnex3_value* indexes,
                                        int32_t index_count, const varnex3_value* value);
/* Stores a record in a property by reference; null sets it to nothing. 13 for a record of another class. */
VARNEX3_API int32_t varnex3_put_reference(varnex3_record* record, const char* property, varnex3_record* value);

/* Calls a method. Optional arguments may be left off the end. After a success each argument whose parameter is an
 * output holds a result, which is the caller's to clear; after an error the arguments are as they were. */
VARNEX3_API int32_t varnex3_call(varnex3_record* record, const char* method, varnex3_value* arguments,
                                 int32_t argument_count, varnex3_value* result);
/* The same for a function of a module, such as "modFunctions", "EscapeXML". */
VARNEX3_API int32_t varnex3_call_function(const char* module, const char* function, varnex3_value* arguments,
                                          int32_t argument_count, varnex3_value* result);

/* The record as JSON, a text: its properties in interface order, children included. */
VARNEX3_API int32_t varnex3_to_json(varnex3_record* record, varnex3_value* result);

/* Frees what a value from the library holds, and makes it empty. */
VARNEX3_API void varnex3_value_clear(varnex3_value* value);

/* ---- the last error of this thread; the texts are valid until its next failing call ---- */

/* 0 when there was none. */
VARNEX3_API int32_t varnex3_error_number(void);
/* The class and operation that raised it, such as "SourceDef.ParseXML". */
VARNEX3_API const char* varnex3_error_source(void);
/* What went wrong, naming the value. */
VARNEX3_API const char* varnex3_error_description(void);

#ifdef __cplusplus
}
#endif
#endif
