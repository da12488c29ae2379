// The shadow of a stick on the floor.
uniform mat4 u_ViewProjection;
uniform vec3 u_Up;
uniform vec3 u_LightVector;
uniform mat4 u_ModelTransform;
uniform vec4 u_ModelColour;

attribute vec3 a_position;

varying vec4 v_Colour;

void main()
{
	v_Colour = u_ModelColour;
	vec3 position = (u_ModelTransform * vec4(a_position, 1.0)).xyz;
	// Along the light, down to the floor.
	position -= u_LightVector * (dot(position, u_Up) / max(dot(u_LightVector, u_Up), 1e-3));
	gl_Position = u_ViewProjection * vec4(position, 1.0);
}
