#ifndef CIMOM_CIMXML_INSTANCEOPERATIONS_H_
#define CIMOM_CIMXML_INSTANCEOPERATIONS_H_

namespace Cimom::CimXml {

struct Call;

/// The operations on instances; each writes IRETURNVALUE where it returns something.
void enumerateInstances(Call& call);
void enumerateInstanceNames(Call& call);
void getInstance(Call& call);
void createInstance(Call& call);
void modifyInstance(Call& call);
void deleteInstance(Call& call);
void getProperty(Call& call);
void setProperty(Call& call);

}  // namespace Cimom::CimXml

#endif  // CIMOM_CIMXML_INSTANCEOPERATIONS_H_
