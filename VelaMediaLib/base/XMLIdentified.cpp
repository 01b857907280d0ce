#include <VelaMediaLib/base/XMLIdentified.h>

#include <VelaMediaLib/base/IdentManager.h>

namespace VelaMediaLib {

uint32_t XMLIdentified::newXMLIdent() { return IdentManager::instance().newIdent(); }

void XMLIdentified::retireXMLIdent(uint32_t ident) { IdentManager::instance().retireIdent(ident); }

} // namespace VelaMediaLib
