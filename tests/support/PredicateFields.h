// A dictionary with a field of every kind that predicates tell apart.

#ifndef KESTREL_TESTS_SUPPORT_PREDICATEFIELDS_H
#define KESTREL_TESTS_SUPPORT_PREDICATEFIELDS_H

namespace kestrel_test {

constexpr char kPredicateFields[] =
    "<DataDictionary numberOfFields='12'>"
    "<DataField name='num' optype='continuous' dataType='double'>"
    "<Value value='99' property='missing'/></DataField>"
    // Labels of a continuous field are no categories.
    "<DataField name='labelled' optype='continuous' dataType='double'>"
    "<Value value='1' property='valid'/><Value value='2' property='valid'/></DataField>"
    "<DataField name='day' optype='continuous' dataType='dateDaysSince[1970]'/>"
    "<DataField name='col' optype='categorical' dataType='string'>"
    "<Value value='red'/><Value value='green'/><Value value='blue'/>"
    "<Value value='none' property='missing'/></DataField>"
    "<DataField name='exact' optype='categorical' dataType='string'>"
    "<Extension name='noSpaceTrim' value='true'/>"
    "<Value value='a'/><Value value='a '/><Value value='b'/></DataField>"
    "<DataField name='nr' optype='categorical' dataType='integer'>"
    "<Value value='3'/><Value value='1'/><Value value='2'/>"
    "<Value value='-9' property='missing'/></DataField>"
    "<DataField name='size' optype='ordinal' dataType='string'>"
    "<Value value='low'/><Value value='mid'/><Value value='high'/></DataField>"
    // The order is the document's, not the numbers'.
    "<DataField name='rank' optype='ordinal' dataType='double'>"
    "<Value value='30'/><Value value='10'/><Value value='20'/>"
    "<Value value='-9' property='missing'/></DataField>"
    "<DataField name='date' optype='ordinal' dataType='dateDaysSince[1970]'>"
    "<Value value='100'/><Value value='200'/><Value value='300'/></DataField>"
    "<DataField name='only' optype='ordinal' dataType='string'><Value value='x'/></DataField>"
    "<DataField name='bare' optype='categorical' dataType='string'/>"
    "<DataField name='bare number' optype='ordinal' dataType='integer'/>"
    "</DataDictionary>";

}  // namespace kestrel_test

#endif  // KESTREL_TESTS_SUPPORT_PREDICATEFIELDS_H
