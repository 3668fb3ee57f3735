/// CIM objects in a request: names, values, instances. Errors are TransportErrors "request-not-valid".
#ifndef CIMOM_CIMXML_OBJECTREADER_H_
#define CIMOM_CIMXML_OBJECTREADER_H_

#include "cimom/cimxml/Document.h"
#include "cimom/cimxml/Request.h"

namespace Cimom::CimXml {

/// NAMESPACE elements in a LOCALNAMESPACEPATH, as "root/cimv2".
std::string readLocalNameSpacePath(const Element& element);

/// CLASSNAME, INSTANCENAME, LOCALCLASSPATH, LOCALINSTANCEPATH, CLASSPATH, INSTANCEPATH.
bool isObjectName(const Element& element);
ObjectName readObjectName(const Element& element);

/// VALUE.ARRAY.
Texts readArray(const Element& element);

/// INSTANCE, VALUE.NAMEDINSTANCE.
bool isInstance(const Element& element);
Instance readInstance(const Element& element);

}  // namespace Cimom::CimXml

#endif  // CIMOM_CIMXML_OBJECTREADER_H_
