// On the sensor of a camera that stands in the scene, a plane at unit distance that the model's transform places.
uniform mat4 u_ViewProjection;
uniform mat4 u_ModelTransform;
uniform vec2 u_SensorSize;
uniform vec4 u_ModelColour;

attribute vec2 a_position;

varying vec4 v_Colour;

void main()
{
	v_Colour = u_ModelColour;
	vec2 position = a_position / u_SensorSize - 0.5;
	gl_Position = u_ViewProjection * (u_ModelTransform * vec4(position, 0.0, 1.0));
}
