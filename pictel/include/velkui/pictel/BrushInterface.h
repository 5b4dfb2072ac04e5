#pragma once

#include <velkcore/RefCountedObject.h>

namespace velkui::pictel {

// A brush is made with its colour or gradient and is immutable.
class BrushInterface : public virtual velkcore::RefCountedObject {
 public:
  ~BrushInterface() override = default;
};

// Gradient fills for ShadePath. Every gradient a supplier makes is also a
// BrushInterface, so it can be handed to FillPath as well (see AsBrush).
class ShaderInterface : public virtual velkcore::RefCountedObject {
 public:
  ~ShaderInterface() override = default;
};

class LinearShaderInterface : public ShaderInterface {
 public:
  ~LinearShaderInterface() override = default;
};

class RadialShaderInterface : public ShaderInterface {
 public:
  ~RadialShaderInterface() override = default;
};

// The brush side of a gradient, or null when the shader is not a brush.
inline const BrushInterface* AsBrush(const ShaderInterface& shader) {
  return dynamic_cast<const BrushInterface*>(&shader);
}

}  // namespace velkui::pictel
