/* The C face as a host in C uses it. Compiled as C: the header has to be. */
#include <stdio.h>
#include <string.h>

#include "varnex3_c.h"

static int passed = 0;
static int failed = 0;

static void check(int holds, const char* rule)
{
    if (holds)
        ++passed;
    else {
        ++failed;
        printf("FAILED: %s (last error %d, %s, %s)\n", rule, (int)varnex3_error_number(), varnex3_error_source(),
               varnex3_error_description());
    }
}

static varnex3_value text(const char* utf8)
{
    varnex3_value value = {VARNEX3_TEXT, 0, 0, NULL, 0, NULL};
    value.text = utf8;
    value.length = strlen(utf8);
    return value;
}

static varnex3_value whole(int32_t number)
{
    varnex3_value value = {VARNEX3_INT32, 0, 0, NULL, 0, NULL};
    value.integer = number;
    return value;
}

static int holds_text(varnex3_value* value, const char* expected)
{
    const int is_same = value->kind == VARNEX3_TEXT && value->length == strlen(expected)
                        && memcmp(value->text, expected, value->length) == 0;
    varnex3_value_clear(value);
    return is_same;
}

static void a_record_is_created_filled_written_and_released(void)
{
    varnex3_record* vehicle = NULL;
    varnex3_value value = text("ABC 123");
    varnex3_value result = {0};
    check(varnex3_create("VehicleDef", &vehicle) == 0, "a record is created by the name of its class");
    check(strcmp(varnex3_class_of(vehicle), "VehicleDef") == 0, "a record knows its class");
    check(varnex3_put(vehicle, "RegistrationNo", &value) == 0, "a property is stored");
    check(varnex3_get(vehicle, "RegistrationNo", &result) == 0 && holds_text(&result, "ABC 123"), "a property is read");
    check(varnex3_call(vehicle, "Serialise", NULL, 0, &result) == 0
              && holds_text(&result, "\t<Vehicle>\r\n\t\t<RegistrationNo>ABC 123</RegistrationNo>\r\n\t</Vehicle>\r\n"),
          "a method is called");
    varnex3_add_ref(vehicle);
    varnex3_release(vehicle);
    varnex3_release(vehicle);
    varnex3_release(NULL);
}

static void an_error_is_a_number_a_source_and_a_description(void)
{
    varnex3_record* record = NULL;
    varnex3_value value = text("three");
    check(varnex3_create("NoSuchDef", &record) == 429 && record == NULL, "an unknown class cannot be created");
    check(strstr(varnex3_error_description(), "'NoSuchDef'") != NULL, "the error names the class");
    check(varnex3_create("modFunctions", &record) == 429, "a module cannot be created");
    check(varnex3_create("ClaimHeaderDef", &record) == 0, "a claim header is created");
    check(varnex3_put(record, "ReinstatementNo", &value) == 13, "a text that is no number does not convert");
    check(varnex3_error_number() == 13 && strcmp(varnex3_error_source(), "ClaimHeaderDef.ReinstatementNo") == 0
              && strcmp(varnex3_error_description(), "'three' is not a number") == 0,
          "number, source and description tell what was wrong");
    check(varnex3_put(record, "Wheels", &value) == 438, "an unknown property is an error");
    check(varnex3_put(record, "Serialise", &value) == 438, "a method is no property");
    check(varnex3_call(record, "VehicleID", NULL, 0, NULL) == 438, "a property is no method");
    check(varnex3_get(NULL, "VehicleID", &value) == 91, "a null handle is an error, not a crash");
    check(varnex3_put(record, "VehicleID", NULL) == 91, "a null value is an error, not a crash");
    value.kind = 99;
    check(varnex3_put(record, "VehicleID", &value) == 5, "a value of unknown kind is an error");
    check(varnex3_call(record, "ParseXML", NULL, 0, NULL) == 449, "a missing argument is an error");
    varnex3_release(record);
}

static void children_travel_by_reference(void)
{
    varnex3_record* customer = NULL;
    varnex3_record* name = NULL;
    varnex3_record* vehicle = NULL;
    varnex3_value value = text("Smith");
    varnex3_value child = {0};
    varnex3_create("CustomerDef", &customer);
    varnex3_create("PersonalNameDef", &name);
    varnex3_create("VehicleDef", &vehicle);
    varnex3_put(name, "Surname", &value);
    check(varnex3_put_reference(customer, "PersonalName", name) == 0, "a child is stored by reference");
    check(varnex3_get(customer, "PersonalName", &child) == 0 && child.record == name,
          "and is the same record when read");
    varnex3_value_clear(&child);
    check(varnex3_put_reference(customer, "PersonalName", vehicle) == 13, "a record of another class is refused");
    check(varnex3_put_reference(customer, "PersonalName", NULL) == 0, "null sets a child to nothing");
    check(varnex3_get(customer, "PersonalName", &child) == 0 && child.record != NULL && child.record != name,
          "which is made again at the next access");
    varnex3_value_clear(&child);
    check(varnex3_to_json(vehicle, &value) == 0 && strstr(value.text, "\"VIN\":\"\"") != NULL,
          "a record is shown as JSON");
    varnex3_value_clear(&value);
    varnex3_release(vehicle);
    varnex3_release(name);
    varnex3_release(customer);
}

static void indexed_properties_and_results_by_reference(void)
{
    varnex3_record* details = NULL;
    varnex3_record* messages = NULL;
    varnex3_value field[2];
    varnex3_value result = {0};
    varnex3_value scan[3] = {{0}, {0}, {0}};
    varnex3_value split[4];

    varnex3_create("InsurerDetailDef", &details);
    field[0] = text("Phone");
    field[1] = text("1");
    check(varnex3_call(details, "Add", field, 2, NULL) == 0, "a result may be left aside");
    field[1] = text("2");
    check(varnex3_put_indexed(details, "Values", field, 1, &field[1]) == 0, "an indexed property is stored");
    check(varnex3_get_indexed(details, "Values", field, 1, &result) == 0 && holds_text(&result, "2"), "and read");
    field[0] = whole(5);
    check(varnex3_get_indexed(details, "Fields", field, 1, &result) == 9, "a position out of range is an error");
    check(varnex3_get_indexed(details, "Fields", NULL, 1, &result) == 5, "indexes that are not there are an error");

    varnex3_create("Xalo_Messages", &messages);
    scan[0] = text("/no such folder");
    check(varnex3_call(messages, "ParseFiles", scan, 3, &result) == 0 && result.kind == VARNEX3_BOOLEAN
              && !result.integer,
          "a scan of a missing folder gives false");
    check(scan[1].integer == 30030 && strcmp(scan[2].text, "Folder '/no such folder' does not exist.") == 0,
          "and says why in its arguments");
    varnex3_value_clear(&scan[1]);
    varnex3_value_clear(&scan[2]);
    check(varnex3_call(messages, "ParseFiles", scan, 1, &result) == 0, "optional arguments may be left off");

    split[0] = text("2004-03-15T14:05:09+10:00");
    split[1] = split[2] = split[3] = text("");
    check(varnex3_call_function("modFunctions", "SplitDateTime", split, 4, &result) == 0, "a function needs no record");
    check(holds_text(&split[1], "2004-03-15") && holds_text(&split[2], "14:05:09") && holds_text(&split[3], "10:00"),
          "and brings its results back");
    check(varnex3_call_function("VehicleDef", "Serialise", NULL, 0, &result) == 91, "a method does");
    varnex3_release(messages);
    varnex3_release(details);
}

static void the_library_describes_itself(void)
{
    varnex3_class info;
    varnex3_member member;
    varnex3_parameter parameter;
    varnex3_enumeration enumeration;
    varnex3_constant constant;
    int32_t value = -1;
    int32_t i;
    int32_t described = 0;
    for (i = 0; varnex3_class_at(i, &info) == 0; ++i) {
        int32_t m;
        for (m = 0; varnex3_member_at(info.name, m, &member) == 0; ++m) {
            int32_t p;
            for (p = 0; varnex3_parameter_at(info.name, m, p, &parameter) == 0; ++p)
                described += parameter.name[0] == '\0';
            described += member.name[0] == '\0' || member.doc[0] == '\0' || p != member.parameter_count;
        }
        described += m != info.member_count;
    }
    check(i == varnex3_class_count() && i > 0 && described == 0, "every class, member and parameter is described");
    check(varnex3_class_at(-1, &info) == 9, "a position out of range is an error");
    for (i = 0; varnex3_enumeration_at(i, &enumeration) == 0; ++i)
        check(varnex3_constant_at(i, 0, &constant) == 0 && constant.name[0] != '\0', "every enumeration has constants");
    check(i == varnex3_enumeration_count() && i > 0, "every enumeration is described");
    check(varnex3_constant_value("CustomerTypeEnum", "Company", &value) == 0 && value == 1,
          "a constant is found by name");
    check(varnex3_constant_value("CustomerTypeEnum", "Wheels", &value) == 5, "an unknown constant is an error");
}

int main(void)
{
    a_record_is_created_filled_written_and_released();
    an_error_is_a_number_a_source_and_a_description();
    children_travel_by_reference();
    indexed_properties_and_results_by_reference();
    the_library_describes_itself();
    printf("%d passed, %d failed\n", passed, failed);
    return failed != 0;
}
