#include "frame/Error.h"

#include <algorithm>
#include <array>

namespace tessel::frame {

std::string ErrorText(int number) {
    struct Words {
        int number;
        std::string_view text;
    };
    static constexpr std::array table = {
        Words{errors::invalidCall, "Invalid argument or call"},
        Words{errors::overflow, "Overflow"},
        Words{errors::outOfMemory, "Out of memory"},
        Words{errors::subscript, "Subscript out of range"},
        Words{errors::divisionByZero, "Division by zero"},
        Words{errors::typeMismatch, "Type mismatch"},
        Words{errors::internal, "Internal error"},
        Words{errors::badFileName, "Bad file name"},
        Words{errors::fileNotFound, "File not found"},
        Words{errors::deviceError, "Device error"},
        Words{errors::fileExists, "File already exists"},
        Words{errors::diskFull, "Disk full"},
        Words{errors::endOfFile, "Read past the end of the file"},
        Words{errors::permissionDenied, "Permission denied"},
        Words{errors::diskNotReady, "Disk not ready"},
        Words{errors::pathAccess, "Path or file cannot be accessed"},
        Words{errors::pathNotFound, "Path not found"},
        Words{errors::objectGone, "The object is not set or no longer exists"},
        Words{errors::noSuchElement, "No such element of the control array"},
        Words{errors::invalidValue, "Invalid property value"},
        Words{errors::invalidArrayIndex, "Invalid property array index"},
        Words{errors::notAtRunTime, "Property cannot be set at run time"},
        Words{errors::notPermitted, "Property cannot be set now"},
        Words{errors::objectRequired, "Object required"},
        Words{errors::noSuchMember, "The object has no such member"},
        Words{errors::notSupported, "The host does not offer this"},
        Words{errors::argumentMissing, "Argument missing"},
        Words{errors::wrongArguments, "Wrong number of arguments"},
        Words{errors::keyInUse, "Key already in use"},
        Words{errors::invalidPicture, "Invalid picture"},
        Words{errors::noCurrentRow, "There is no current row: the recordset is empty or stands at its end"},
        Words{errors::dataSourceError, "The data source has failed"},
        Words{errors::noSuchField, "The recordset has no such field"},
        Words{errors::indexOutOfBounds, "Index out of bounds"},
        Words{errors::elementNotFound, "Element not found"},
        Words{errors::keyNotUnique, "Key is not unique in the collection"},
    };
    const auto found = std::find_if(table.begin(), table.end(), [&](const Words& words) { return words.number == number; });
    return found != table.end() ? std::string(found->text) : "Error " + std::to_string(number);
}

}  // namespace tessel::frame
