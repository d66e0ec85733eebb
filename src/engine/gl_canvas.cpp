#include "engine/gl_canvas.h"

#include "engine/gl_programs.h"
#include "util/failure.h"
#include "util/rounding.h"

#include <bit>
#include <string>

static_assert(std::endian::native == std::endian::little);  // a packed colour with its alpha is four bytes, red first

namespace {

template <typename T>
std::size_t bytesOf(const std::vector<T>& list) {
    return list.size() * sizeof(T);
}

const void* bufferOffset(std::size_t bytes) {
    return reinterpret_cast<const void*>(bytes);
}

void checkErrors(const GLApi& api) {
    const GLenum error = api.GetError();
    if (error == GL_NO_ERROR) return;
    while (api.GetError() != GL_NO_ERROR) {
    }
    throw Failure(error == GL_OUT_OF_MEMORY ? std::string("The display does not fit the memory for OpenGL")
                                            : "OpenGL reports error " + std::to_string(error));
}

}  // namespace

void GLCanvas::create(const GLApi& api, const GLPlan& plan, const QImage& picture, const GLBackground& background,
                      std::int32_t listed) try {
    api_ = api;
    background_ = background;
    shapes_ = plan.Shapes;
    GLint mostSlots = 0;
    api_.GetIntegerv(GL_MAX_TEXTURE_BUFFER_SIZE, &mostSlots);
    require(plan.SlotColors.size() <= static_cast<std::size_t>(mostSlots),
            "The display has too many lights for OpenGL");

    backgroundProgram_ = makeProgram(api_, kBackgroundSource);
    bulbProgram_ = makeProgram(api_, kBulbSource);
    listProgram_ = makeProgram(api_, kListSource);
    createBuffers(plan, listed);
    createArrays();
    createPicture(picture);

    api_.UseProgram(backgroundProgram_);
    api_.Uniform1i(api_.GetUniformLocation(backgroundProgram_, "picture"), 0);
    api_.Uniform1i(api_.GetUniformLocation(backgroundProgram_, "textured"), background_.ZephGLHasTexture ? 1 : 0);
    api_.Uniform1f(api_.GetUniformLocation(backgroundProgram_, "alpha"),
                   static_cast<float>(background_.ZephGLBackgroundAlpha));
    api_.Uniform2f(api_.GetUniformLocation(backgroundProgram_, "size"), static_cast<float>(background_.ZephGLWidth),
                   static_cast<float>(background_.ZephGLHeight));
    api_.UseProgram(bulbProgram_);
    api_.Uniform1i(api_.GetUniformLocation(bulbProgram_, "slots"), 1);
    api_.Enable(GL_BLEND);
    api_.BlendFunc(GL_SRC_ALPHA, GL_ONE_MINUS_SRC_ALPHA);
    api_.Disable(GL_DITHER);
    api_.ClearColor(0, 0, 0, 0);
    setViewport(truncateToInt(background_.ZephGLWidth), truncateToInt(background_.ZephGLHeight), 1.0);
    checkErrors(api_);
} catch (...) {
    destroy();
    throw;
}

void GLCanvas::destroy() {
    if (api_.DeleteProgram != nullptr) {
        for (const GLuint program : {backgroundProgram_, bulbProgram_, listProgram_})
            api_.DeleteProgram(program);
        for (const GLuint texture : {slotTexture_, picture_})
            api_.DeleteTextures(1, &texture);
        api_.DeleteVertexArrays(kArrayCount, arrays_.data());
        api_.DeleteBuffers(kBufferCount, buffers_.data());
    }
    forget();
}

void GLCanvas::forget() {
    api_ = {};
    backgroundProgram_ = bulbProgram_ = listProgram_ = slotTexture_ = picture_ = 0;
    arrays_ = {};
    buffers_ = {};
    shapes_.clear();
}

void GLCanvas::fillBuffer(Buffer buffer, GLenum target, std::size_t bytes, const void* data, GLenum usage) {
    api_.BindBuffer(target, buffers_[buffer]);
    api_.BufferData(target, static_cast<GLsizeiptr>(bytes), data, usage);
}

void GLCanvas::createBuffers(const GLPlan& plan, std::int32_t listed) {
    slotBytes_ = std::max<std::size_t>(1, plan.SlotColors.size()) * sizeof(std::uint32_t);
    instanceBytes_ = static_cast<std::size_t>(listed) * sizeof(GLInstance);
    api_.BindVertexArray(0);
    api_.GenBuffers(kBufferCount, buffers_.data());
    fillBuffer(kVertices, GL_ARRAY_BUFFER, bytesOf(plan.Vertices), plan.Vertices.data(), GL_STATIC_DRAW);
    fillBuffer(kCorners, GL_ARRAY_BUFFER, bytesOf(plan.Corners), plan.Corners.data(), GL_STATIC_DRAW);
    fillBuffer(kInstances, GL_ARRAY_BUFFER, instanceBytes_, nullptr, GL_STREAM_DRAW);
    // Indices are bound to an array, so here they are filled through a target that is not.
    fillBuffer(kIndices, GL_COPY_WRITE_BUFFER, bytesOf(plan.Indices), plan.Indices.data(), GL_STATIC_DRAW);
    fillBuffer(kCornerIndices, GL_COPY_WRITE_BUFFER, bytesOf(plan.CornerIndices), plan.CornerIndices.data(),
               GL_STATIC_DRAW);
    fillBuffer(kSlotColors, GL_TEXTURE_BUFFER, slotBytes_, nullptr, GL_STREAM_DRAW);
    api_.GenTextures(1, &slotTexture_);
    api_.ActiveTexture(GL_TEXTURE1);
    api_.BindTexture(GL_TEXTURE_BUFFER, slotTexture_);
    api_.TexBuffer(GL_TEXTURE_BUFFER, GL_RGBA8, buffers_[kSlotColors]);
}

void GLCanvas::createArrays() {
    api_.GenVertexArrays(kArrayCount, arrays_.data());
    api_.BindVertexArray(arrays_[kBulbArray]);
    api_.BindBuffer(GL_ELEMENT_ARRAY_BUFFER, buffers_[kIndices]);
    api_.BindBuffer(GL_ARRAY_BUFFER, buffers_[kVertices]);
    api_.EnableVertexAttribArray(kPlaceAttribute);
    api_.VertexAttribPointer(kPlaceAttribute, 2, GL_SHORT, GL_FALSE, sizeof(GLVertex),
                             bufferOffset(offsetof(GLVertex, X)));
    api_.EnableVertexAttribArray(kSlotAttribute);
    api_.VertexAttribIPointer(kSlotAttribute, 1, GL_UNSIGNED_INT, sizeof(GLVertex),
                              bufferOffset(offsetof(GLVertex, Slot)));

    api_.BindVertexArray(arrays_[kListArray]);
    api_.BindBuffer(GL_ELEMENT_ARRAY_BUFFER, buffers_[kCornerIndices]);
    api_.BindBuffer(GL_ARRAY_BUFFER, buffers_[kCorners]);
    api_.EnableVertexAttribArray(kPlaceAttribute);
    api_.VertexAttribPointer(kPlaceAttribute, 2, GL_SHORT, GL_FALSE, sizeof(GLCorner),
                             bufferOffset(offsetof(GLCorner, X)));
    for (const GLuint attribute : {kCentreAttribute, kColorAttribute}) {
        api_.EnableVertexAttribArray(attribute);
        api_.VertexAttribDivisor(attribute, 1);
    }
}

void GLCanvas::createPicture(const QImage& picture) {
    background_.ZephGLHasTexture = !picture.isNull();
    if (picture.isNull()) return;
    const QImage pixels = picture.convertToFormat(QImage::Format_RGB32);  // whose lines lie side by side
    api_.GenTextures(1, &picture_);
    api_.ActiveTexture(GL_TEXTURE0);
    api_.BindTexture(GL_TEXTURE_2D, picture_);
    for (const auto& [name, value] : {std::pair<GLenum, GLint>{GL_TEXTURE_MIN_FILTER, GL_LINEAR},
                                      {GL_TEXTURE_MAG_FILTER, GL_LINEAR},
                                      {GL_TEXTURE_WRAP_S, GL_CLAMP_TO_EDGE},
                                      {GL_TEXTURE_WRAP_T, GL_CLAMP_TO_EDGE}}) {
        api_.TexParameteri(GL_TEXTURE_2D, name, value);
    }
    api_.TexImage2D(GL_TEXTURE_2D, 0, GL_RGBA8, pixels.width(), pixels.height(), 0, GL_BGRA,
                    GL_UNSIGNED_INT_8_8_8_8_REV, pixels.constBits());
}

void GLCanvas::setViewport(std::int32_t width, std::int32_t height, double pixelRatio) {
    if (api_.Viewport == nullptr || width < 1 || height < 1) return;
    api_.Viewport(0, 0, roundHalfEven(width * pixelRatio), roundHalfEven(height * pixelRatio));
    for (const GLuint program : {backgroundProgram_, bulbProgram_, listProgram_}) {
        api_.UseProgram(program);
        api_.Uniform2f(api_.GetUniformLocation(program, "view"), 2.0F / static_cast<float>(width),
                       2.0F / static_cast<float>(height));
    }
}

void GLCanvas::ZephGLBeginFrame() {
    api_.Clear(GL_COLOR_BUFFER_BIT);
    api_.UseProgram(backgroundProgram_);
    api_.BindVertexArray(arrays_[kNoArray]);
    api_.DrawArrays(GL_TRIANGLE_STRIP, 0, 4);
}

void GLCanvas::upload(const GLWork& work) {
    // The old storage is let go whole, so that nothing waits for the frame that may still be read from it.
    if (work.EndSlot > work.FirstSlot) {
        const auto first = static_cast<std::size_t>(work.FirstSlot);
        fillBuffer(kSlotColors, GL_TEXTURE_BUFFER, slotBytes_, nullptr, GL_STREAM_DRAW);
        api_.BufferSubData(GL_TEXTURE_BUFFER, static_cast<GLintptr>(first * sizeof(std::uint32_t)),
                           static_cast<GLsizeiptr>((work.EndSlot - work.FirstSlot) * GLsizeiptr{sizeof(std::uint32_t)}),
                           work.SlotColors.data() + first);
    }
    if (!work.Instances.empty()) {
        fillBuffer(kInstances, GL_ARRAY_BUFFER, instanceBytes_, nullptr, GL_STREAM_DRAW);
        api_.BufferSubData(GL_ARRAY_BUFFER, 0, static_cast<GLsizeiptr>(bytesOf(work.Instances)), work.Instances.data());
    }
}

void GLCanvas::draw(const GLWork& work) {
    for (const GLBatch& batch : work.Batches) {
        if (batch.Shape < 0) {
            api_.UseProgram(bulbProgram_);
            api_.BindVertexArray(arrays_[kBulbArray]);
            api_.MultiDrawElements(GL_TRIANGLES, work.RangeCounts.data() + batch.First, GL_UNSIGNED_INT,
                                   work.RangeOffsets.data() + batch.First, batch.Count);
            continue;
        }
        const std::size_t first = static_cast<std::size_t>(batch.First) * sizeof(GLInstance);
        const GLShapeRange& shape = shapes_[static_cast<std::size_t>(batch.Shape)];
        api_.UseProgram(listProgram_);
        api_.BindVertexArray(arrays_[kListArray]);
        api_.BindBuffer(GL_ARRAY_BUFFER, buffers_[kInstances]);
        api_.VertexAttribPointer(kCentreAttribute, 2, GL_SHORT, GL_FALSE, sizeof(GLInstance),
                                 bufferOffset(first + offsetof(GLInstance, X)));
        api_.VertexAttribPointer(kColorAttribute, 4, GL_UNSIGNED_BYTE, GL_TRUE, sizeof(GLInstance),
                                 bufferOffset(first + offsetof(GLInstance, Color)));
        api_.DrawElementsInstanced(GL_TRIANGLES, shape.IndexCount, GL_UNSIGNED_SHORT,
                                   bufferOffset(static_cast<std::size_t>(shape.FirstIndex) * sizeof(std::uint16_t)),
                                   batch.Count);
    }
}
