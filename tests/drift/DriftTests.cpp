#include <gtest/gtest.h>

#include "tests/drift/Matrix.h"

namespace tavro::drift {
namespace {

void expectAllPass(const char* what, const Matrix& matrix, const std::vector<Case>& cases) {
  const Outcome outcome = matrix.run(cases);
  for (const std::string& failure : outcome.failures) {
    ADD_FAILURE() << failure;
  }
  std::cout << what << ": " << outcome.summary << std::endl;
}

TEST(Drift, EverySingleMutation) {
  const Matrix matrix;
  ASSERT_EQ(matrix.problem(), "");
  expectAllPass("single mutations", matrix, matrix.singles());
}

TEST(Soak, EveryPairOfMutationsOfACategory) {
  const Matrix matrix;
  ASSERT_EQ(matrix.problem(), "");
  expectAllPass("pairs of mutations", matrix, matrix.pairs());
}

}  // namespace
}  // namespace tavro::drift
