#ifndef CIMOM_CIMXML_ASSOCIATIONOPERATIONS_H_
#define CIMOM_CIMXML_ASSOCIATIONOPERATIONS_H_

namespace Cimom::CimXml {

struct Call;

/// The traversals of associations from an instance; each writes IRETURNVALUE.
void associators(Call& call);
void associatorNames(Call& call);
void references(Call& call);
void referenceNames(Call& call);

}  // namespace Cimom::CimXml

#endif  // CIMOM_CIMXML_ASSOCIATIONOPERATIONS_H_
