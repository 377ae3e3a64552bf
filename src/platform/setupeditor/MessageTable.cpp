#include "MessageTable.h"

namespace {
struct Message {
    unsigned id;
    const char* text;
};
constexpr Message kMessages[] = {
    {4107, "At least three points are required to define an area or a volume"},
    {4112, "File is not valid"},
    {4115, "The sum of fraction distributions in a layer must be 100"},
    {4116, "Illegal import file:\nFormat is \"x y z name\", where name is optional."},
    {4117, "Illegal layer value in %s"},
    {4118, "Illegal layer value in volume specification"},
    {4120, "Constant value must be larger than or equal to 0.0"},
    {4122, "First time step invalid"},
    {4123, "Invalid time step frequency"},
    {4124, "Last time step invalid"},
    {4127, "Values out of range"},
    {4128, "Sum of weights should be 100"},
};
}  // namespace

CString LoadMessage(unsigned id) {
    for (const Message& m : kMessages)
        if (m.id == id)
            return m.text;
    return "Message " + std::to_string(id);
}
