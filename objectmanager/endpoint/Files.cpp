#include "objectmanager/endpoint/Files.h"

#include "objectmanager/mof/MofError.h"
#include "objectmanager/mof/Parser.h"

#include <algorithm>
#include <fstream>
#include <sstream>

namespace endpoint {
namespace {

using Classes = std::vector<om::ClassDeclaration>;

Classes parse(const std::vector<std::string>& files) {
    Classes found;
    for (const std::string& file : files) {
        for (om::ClassDeclaration& declared : mof::parse(contentOf(file), file)) found.push_back(std::move(declared));
    }
    return found;
}

/// The standard's classes that are built in; none where one of them is among the others.
Classes standardBefore(const Classes& others) {
    const om::Schema& builtin = om::Schema::builtin();
    const std::vector<std::string> served = builtin.served();
    Classes standard;
    for (const om::ClassDeclaration& declared : builtin.classes()) {
        if (om::containsName(served, declared.name)) continue;
        const bool again = std::any_of(others.begin(), others.end(), [&](const om::ClassDeclaration& other) {
            return om::sameName(other.name, declared.name);
        });
        if (again) return {};
        standard.push_back(declared);
    }
    return standard;
}

} // namespace

std::string contentOf(const std::string& file) {
    std::ifstream stream(file, std::ios::binary);
    std::ostringstream content;
    content << stream.rdbuf();
    if (!stream || content.str().empty()) throw std::invalid_argument("cannot read " + file);
    return content.str();
}

SchemaFiles::SchemaFiles(const std::vector<std::string>& files) {
    if (files.empty()) return;
    try {
        Classes declared = parse(files);
        read.emplace(standardBefore(declared));
        read->add(std::move(declared), false);
    } catch (const mof::MofError& error) {
        throw std::invalid_argument(error.what());
    }
    std::string complaints;
    for (const std::string& each : read->complaints()) complaints += (complaints.empty() ? "" : "; ") + each;
    if (!complaints.empty()) throw std::invalid_argument(complaints);
}

const om::Schema& SchemaFiles::schema() const {
    return read ? read->schema() : om::Schema::builtin();
}

} // namespace endpoint
