#pragma once

#include "objectmanager/model/Schema.h"

/// A few classes, apart from those that the object manager ships with.
namespace vkcim {

inline const om::Schema& testSchema() {
    static const auto property = [](const char* name, int type, bool key = false) {
        om::PropertyDeclaration declaration;
        declaration.name = name;
        declaration.type = static_cast<CMPIType>(type);
        declaration.key = key;
        return declaration;
    };
    static const om::Schema schema = [] {
        om::ClassDeclaration thing;
        thing.name = "Test_Thing";
        thing.properties = {property("Name", CMPI_string, true), property("Speed", CMPI_uint16),
                            property("States", CMPI_uint16A),    property("Since", CMPI_dateTime),
                            property("Owner", CMPI_ref),         property("Inside", CMPI_instance)};
        om::MethodDeclaration start;
        start.name = "Start";
        start.returnType = CMPI_uint32;
        om::ParameterDeclaration level;
        level.name = "Level";
        level.type = CMPI_sint8;
        start.parameters = {level};
        thing.methods = {start};
        om::ClassDeclaration special;
        special.name = "Test_SpecialThing";
        special.superclass = "Test_Thing";
        om::ClassDeclaration link;
        link.name = "Test_Link";
        link.association = true;
        link.properties = {property("From", CMPI_ref, true), property("To", CMPI_ref, true)};
        return om::Schema({thing, special, link});
    }();
    return schema;
}

} // namespace vkcim
