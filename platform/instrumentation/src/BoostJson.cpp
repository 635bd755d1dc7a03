// What Boost.JSON's parser is made of besides its headers: nothing of it is linked from elsewhere.
#include <boost/json/src.hpp>
