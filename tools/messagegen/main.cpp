// protoc --plugin=protoc-gen-messagegen=messagegen --messagegen_out=OUT --proto_path=ROOT FILE.proto…

#include <google/protobuf/compiler/plugin.h>

#include "generator.h"

int main(int argc, char** argv) {
  const messagegen::MessageGenerator generator;
  return google::protobuf::compiler::PluginMain(argc, argv, &generator);
}
