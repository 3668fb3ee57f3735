#ifndef CIMOM_CIMXML_CLASSOPERATIONS_H_
#define CIMOM_CIMXML_CLASSOPERATIONS_H_

namespace Cimom::CimXml {

struct Call;

/// The operations that read the schema; each writes IRETURNVALUE.
void getClass(Call& call);
void enumerateClasses(Call& call);
void enumerateClassNames(Call& call);

}  // namespace Cimom::CimXml

#endif  // CIMOM_CIMXML_CLASSOPERATIONS_H_
