#include "host/system/texts/Translate.h"

#include <libintl.h>

namespace host::system {

std::string translated(const char* key)
{
    return dgettext(textDomain, key);
}

} // namespace host::system
